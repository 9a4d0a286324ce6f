#include "platform/SettingsStore.h"

#include <QLocale>

#include <charconv>
#include <cmath>
#include <limits>

double parseSingle(const QString& text, double def) {
    bool ok = false;
    const double value = QLocale::c().toDouble(text.trimmed(), &ok);
    if (!ok || !std::isfinite(value) || std::fabs(value) > std::numeric_limits<float>::max())
        return def;
    return static_cast<float>(value);
}

std::optional<qint64> tryParseLong(const QString& text) {
    bool ok = false;
    const QString t = text.trimmed();
    const qint64 value = t.toLongLong(&ok, 10);
    if (ok)
        return value;
    // Numbers written with a fraction ("12.0") still convert, rounded half to even.
    const double d = QLocale::c().toDouble(t, &ok);
    if (!ok || !std::isfinite(d) || std::fabs(d) > 9.0e15)
        return std::nullopt;
    return static_cast<qint64>(std::nearbyint(d));
}

bool parseBool(const QString& text, bool def) {
    const QString t = text.trimmed();
    if (t.compare(QLatin1String("True"), Qt::CaseInsensitive) == 0)
        return true;
    if (t.compare(QLatin1String("False"), Qt::CaseInsensitive) == 0)
        return false;
    bool ok = false;
    const double d = QLocale::c().toDouble(t, &ok);
    if (ok && std::isfinite(d))
        return d != 0.0;
    return def;
}

quint32 parseColour(const QString& text, quint32 def) {
    const std::optional<qint64> value = tryParseLong(text);
    // Colours are 32-bit; a stored value outside that range is not a colour.
    if (!value || *value < std::numeric_limits<qint32>::min() ||
        *value > std::numeric_limits<quint32>::max())
        return def;
    return static_cast<quint32>(*value);
}

QString boolText(bool value) {
    return value ? QStringLiteral("True") : QStringLiteral("False");
}

QString singleText(double value) {
    // The shortest text that reads back as the same single-precision number: formatted as
    // a float, not widened to a double first, which would add digits the single never had.
    char text[32];
    const std::to_chars_result end =
        std::to_chars(text, text + sizeof text, static_cast<float>(value));
    return QString::fromLatin1(text, end.ptr - text);
}
