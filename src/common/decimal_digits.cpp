#include "common/decimal_digits.h"

#include <array>
#include <bit>
#include <charconv>
#include <cmath>
#include <cstring>

namespace ardcard::detail {

namespace {

constexpr auto kPow10 = [] {
    std::array<std::uint64_t, 16> p{};
    p[0] = 1;
    for (std::size_t k = 1; k < p.size(); ++k)
        p[k] = p[k - 1] * 10;
    return p;
}();

// 5^k for k = 0..27: a 53-bit mantissa times 5^27 still fits in 128 bits.
constexpr auto kPow5 = [] {
    std::array<std::uint64_t, 28> p{};
    p[0] = 1;
    for (std::size_t k = 1; k < p.size(); ++k)
        p[k] = p[k - 1] * 5;
    return p;
}();

using Wide = unsigned __int128; // GCC's and clang's 128-bit integer

// The digits in integers, exactly, for 1e-13 <= magnitude < 1e15 (every
// amount a company holds): magnitude x 10^k for k = 14 - e, where
// 10^e <= magnitude < 10^(e+1), is mantissa x 5^k / 2^shift.
bool digitsInIntegers(double magnitude, SignificantDigits& d) {
    if (!(magnitude >= 1e-13 && magnitude < 1e15))
        return false;
    const auto bits = std::bit_cast<std::uint64_t>(magnitude);
    const std::uint64_t mantissa =
        (bits & ((std::uint64_t{1} << 52) - 1)) | (std::uint64_t{1} << 52);
    const int exp2 = static_cast<int>(bits >> 52) - 1022; // magnitude = mantissa x 2^(exp2-53)
    // e from the binary exponent: 1233 / 4096 is just below log10 2, so the
    // guess is e or one less, and the product tells which.
    int e = ((exp2 - 1) * 1233) >> 12;
    for (int attempt = 0; attempt < 2; ++attempt, ++e) {
        const int k = 14 - e;
        const int shift = 53 - exp2 - k;
        if (k < 0 || k >= static_cast<int>(kPow5.size()) || shift <= 0 || shift >= 127)
            return false;
        const Wide product = static_cast<Wide>(mantissa) * kPow5[static_cast<std::size_t>(k)];
        const auto whole = static_cast<std::uint64_t>(product >> shift);
        if (whole >= kPow10[15])
            continue; // e was one short
        const Wide rest = product & ((Wide{1} << shift) - 1);
        const Wide half = Wide{1} << (shift - 1);
        d.digits = whole;
        d.exponent = -k;
        if (rest > half || (rest == half && (whole & 1) != 0))
            ++d.digits;
        if (d.digits == kPow10[15]) { // 999...9.5 rounds up to one more digit
            d.digits = kPow10[14];
            ++d.exponent;
        }
        return d.digits >= kPow10[14];
    }
    return false;
}

// The library's correctly rounded conversion, for the far ends of the range.
void digitsFromText(double magnitude, SignificantDigits& d) {
    char buf[32]; // "d.dddddddddddddde+XXX"
    const auto res =
        std::to_chars(buf, buf + sizeof buf, magnitude, std::chars_format::scientific, 14);
    const char* const e = static_cast<const char*>(std::memchr(buf, 'e', res.ptr - buf));
    auto digits = static_cast<std::uint64_t>(buf[0] - '0');
    for (const char* p = buf + 2; p < e; ++p)
        digits = digits * 10 + static_cast<std::uint64_t>(*p - '0');
    int exponent = 0;
    std::from_chars(e + (e[1] == '+' ? 2 : 1), res.ptr, exponent);
    d.digits = digits;
    d.exponent = exponent - 14;
}

} // namespace

SignificantDigits ToSignificantDigits(double value) {
    SignificantDigits d;
    if (!std::isfinite(value) || value == 0.0)
        return d;
    d.negative = value < 0;
    const double magnitude = std::fabs(value);
    if (!digitsInIntegers(magnitude, d))
        digitsFromText(magnitude, d);
    return d;
}

Scaled RoundedScaled(const SignificantDigits& d, int decimals) {
    // |value| x 10^decimals = digits x 10^shift
    const int shift = d.exponent + decimals;
    if (shift >= 0)
        return {d.digits, d.digits == 0 ? 0 : shift};
    const int drop = -shift;
    if (drop >= static_cast<int>(kPow10.size()))
        return {}; // digits < 10^15 is below half of 10^16
    const std::uint64_t unit = kPow10[static_cast<std::size_t>(drop)];
    return {d.digits / unit + ((d.digits % unit) * 2 >= unit ? 1 : 0), 0};
}

} // namespace ardcard::detail
