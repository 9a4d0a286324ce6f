#include "emulator/LeadingNumber.h"

#include <QLocale>

#include <charconv>
#include <cmath>
#include <limits>

namespace {

bool isBlank(QChar c) {
    return c == u' ' || c == u'\t' || c == u'\n' || c == u'\r';
}

bool isDigit(QChar c) {
    return c >= u'0' && c <= u'9';
}

qsizetype skipBlanks(QStringView text, qsizetype i) {
    while (i < text.size() && isBlank(text[i]))
        ++i;
    return i;
}

// The length of the decimal number that starts at `from`, or 0 when none does.
qsizetype numberLength(QStringView text, qsizetype from) {
    qsizetype i = from;
    if (i < text.size() && (text[i] == u'+' || text[i] == u'-'))
        ++i;
    qsizetype digits = 0;
    while (i < text.size() && isDigit(text[i])) {
        ++i;
        ++digits;
    }
    if (i < text.size() && text[i] == u'.') {
        ++i;
        while (i < text.size() && isDigit(text[i])) {
            ++i;
            ++digits;
        }
    }
    if (digits == 0)
        return 0;
    // An exponent counts only when digits follow it: "12e" is 12.
    if (i < text.size() && (text[i] == u'e' || text[i] == u'E')) {
        qsizetype j = i + 1;
        if (j < text.size() && (text[j] == u'+' || text[j] == u'-'))
            ++j;
        if (j < text.size() && isDigit(text[j])) {
            while (j < text.size() && isDigit(text[j]))
                ++j;
            i = j;
        }
    }
    return i - from;
}

double convert(QStringView number) {
    // The C locale's reading; on overflow it yields an infinity and on underflow 0, which
    // is what the callers want, so its "ok" is not needed.
    bool ok = false;
    return QLocale::c().toDouble(number, &ok);
}

} // namespace

double leadingNumber(QStringView text) {
    const qsizetype start = skipBlanks(text, 0);
    const qsizetype length = numberLength(text, start);
    return length == 0 ? 0.0 : convert(text.mid(start, length));
}

float leadingSingle(QStringView text) {
    const double value = leadingNumber(text);
    constexpr double kMax = std::numeric_limits<float>::max();
    if (value > kMax)
        return std::numeric_limits<float>::max();
    if (value < -kMax)
        return std::numeric_limits<float>::lowest();
    return static_cast<float>(value);
}

std::optional<double> wholeDecimalNumber(QStringView text) {
    const qsizetype start = skipBlanks(text, 0);
    const qsizetype length = numberLength(text, start);
    if (length == 0 || skipBlanks(text, start + length) != text.size())
        return std::nullopt;
    return convert(text.mid(start, length));
}

namespace {

template <typename Number> QString shortestText(Number value) {
    if (!std::isfinite(value) || value == Number(0))
        return QStringLiteral("0");
    char buffer[64];
    const Number magnitude = std::fabs(value);
    // Digits without an exponent wherever a person would write them so.
    const bool plain = magnitude >= Number(1e-5) && magnitude < Number(1e15);
    const std::to_chars_result r =
        plain ? std::to_chars(buffer, buffer + sizeof buffer, value, std::chars_format::fixed)
              : std::to_chars(buffer, buffer + sizeof buffer, value);
    if (r.ec != std::errc())
        return QStringLiteral("0");
    return QString::fromLatin1(buffer, r.ptr - buffer);
}

} // namespace

QString shortestDecimalText(float value) {
    return shortestText(value);
}

QString shortestDecimalText(double value) {
    return shortestText(value);
}
