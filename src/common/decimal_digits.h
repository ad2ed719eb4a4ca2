#pragma once

#include <string>

namespace ardcard::detail {

// A finite double as 15 significant decimal digits, the precision at which
// the host product's formats and text conversions see a number. `digits`
// holds exactly 15 digits d1..d15 and value = d1.d2...d15 x 10^exponent.
// Zero (and -0.0) gives fifteen zeros and exponent 0.
struct DecimalDigits {
    std::string digits;
    int exponent = 0;
    bool negative = false;
};
DecimalDigits toDecimalDigits(double value);

// |value| rounded half away from zero to `decimals` places, as a digit string
// without a decimal point (the value times 10^decimals); "0" for zero.
std::string roundedScaled(const DecimalDigits& d, int decimals);

} // namespace ardcard::detail
