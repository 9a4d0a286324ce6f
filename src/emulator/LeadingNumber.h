#pragma once

#include <QString>
#include <QStringView>

#include <optional>

// How the option fields turn user text into numbers and numbers back into text.

// The value of the longest decimal number at the start of `text` after leading blanks:
// an optional sign, digits with an optional fraction, and an optional exponent
// ("  12abc" is 12, "-1.5e2x" is -150, ".5" is 0.5). Text without such a number gives 0.
// Too large a number gives an infinity of its sign, too small a one 0.
double leadingNumber(QStringView text);

// leadingNumber as a single-precision value, kept finite: beyond the single range it is
// the largest single of its sign, so whatever the user typed can be saved and read back.
float leadingSingle(QStringView text);

// The value of `text` when all of it, apart from surrounding blanks, is one decimal number
// of the form leadingNumber reads; empty otherwise.
std::optional<double> wholeDecimalNumber(QStringView text);

// The shortest text that reads back as the same single ("0", "1.5", "4608", "0.001");
// plain digits for everyday magnitudes, an exponent only for very large or very small
// ones ("1e+20"). Minus zero is "0". Not-a-number and infinities give "0".
QString shortestDecimalText(float value);
// The same for a double.
QString shortestDecimalText(double value);
