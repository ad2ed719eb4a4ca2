#pragma once

#include <cstdint>

namespace ardcard::detail {

// A double as the host product's formats and text conversions see it: its
// magnitude at 15 significant digits, value = digits x 10^exponent with
// 10^14 <= digits < 10^15, correctly rounded from the exact binary value
// (an exact tie to the even digit). Zero, -0.0 and values that are not
// finite give digits 0.
struct SignificantDigits {
    std::uint64_t digits = 0;
    int exponent = 0;
    bool negative = false;
};
SignificantDigits ToSignificantDigits(double value);

// |value| rounded half away from zero to `decimals` places (0 or more): the
// value times 10^decimals is `scaled` followed by `zeros` zeros (a large
// value's digits beyond its 15 significant ones).
struct Scaled {
    std::uint64_t scaled = 0;
    int zeros = 0;
};
Scaled RoundedScaled(const SignificantDigits& d, int decimals);

} // namespace ardcard::detail
