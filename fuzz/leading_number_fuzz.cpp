// The leading-number parse every numeric option field uses, against any text; checked
// against the standard library's own reading of the same number.
#include "FuzzSupport.h"

#include "emulator/LeadingNumber.h"

#include <charconv>
#include <cmath>
#include <string>
#include <system_error>

namespace {

bool sameNumber(double a, double b) {
    return (std::isnan(a) && std::isnan(b)) || a == b;
}

// The standard library's reading: blanks, then what from_chars takes as a decimal number.
// Empty when it cannot tell (a result out of the double range).
std::optional<double> reference(const QString& text) {
    const std::string s = text.toStdString();
    std::size_t i = s.find_first_not_of(" \t\r\n");
    if (i == std::string::npos)
        return 0.0;
    bool negative = false;
    if (s[i] == '+' || s[i] == '-') {
        negative = s[i] == '-';
        ++i;
    }
    // from_chars also reads "inf" and "nan", which are no numbers to the option fields,
    // and a sign of its own after ours.
    if (i == s.size() || !(std::isdigit(static_cast<unsigned char>(s[i])) || s[i] == '.'))
        return 0.0;
    double value = 0;
    const auto [end, error] =
        std::from_chars(s.data() + i, s.data() + s.size(), value, std::chars_format::general);
    if (error == std::errc::invalid_argument)
        return 0.0;
    if (error != std::errc())
        return std::nullopt;
    (void)end;
    return negative ? -value : value;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const QString text = QString::fromUtf8(reinterpret_cast<const char*>(data), qsizetype(size));
    const double number = leadingNumber(text);
    FUZZ_CHECK(!std::isnan(number));
    if (const std::optional<double> expected = reference(text))
        FUZZ_CHECK(sameNumber(number, *expected));

    // Only the leading number counts: anything after it changes nothing.
    FUZZ_CHECK(sameNumber(leadingNumber(text + u'x'), number));

    const float single = leadingSingle(text);
    FUZZ_CHECK(std::isfinite(single));
    // A saved value shows as a text that reads back as the same value.
    FUZZ_CHECK(leadingSingle(shortestDecimalText(single)) == single);

    if (const std::optional<double> whole = wholeDecimalNumber(text))
        FUZZ_CHECK(sameNumber(*whole, number));
    return 0;
}
