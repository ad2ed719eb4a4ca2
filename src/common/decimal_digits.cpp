#include "common/decimal_digits.h"

#include <charconv>
#include <cmath>
#include <cstdlib>

namespace ardcard::detail {

DecimalDigits toDecimalDigits(double value) {
    DecimalDigits d;
    if (!std::isfinite(value) || value == 0.0) {
        d.digits.assign(15, '0');
        return d;
    }
    d.negative = value < 0;
    char buf[64];
    const auto res =
        std::to_chars(buf, buf + sizeof buf, std::fabs(value), std::chars_format::scientific, 14);
    // buf holds "d.dddddddddddddde+XX"
    const std::string_view text(buf, static_cast<size_t>(res.ptr - buf));
    const size_t e = text.find('e');
    d.digits.reserve(15);
    d.digits += text[0];
    d.digits.append(text.substr(2, e - 2));
    d.exponent = std::atoi(std::string(text.substr(e + 1)).c_str());
    return d;
}

std::string roundedScaled(const DecimalDigits& d, int decimals) {
    // value * 10^decimals = digits * 10^shift
    const int shift = d.exponent - 14 + decimals;
    std::string n;
    if (shift >= 0) {
        n = d.digits;
        n.append(static_cast<size_t>(shift), '0');
    } else {
        const int keep = 15 + shift;
        if (keep < 0)
            return "0";
        n = d.digits.substr(0, static_cast<size_t>(keep));
        if (d.digits[static_cast<size_t>(keep)] >= '5') {
            int i = static_cast<int>(n.size()) - 1;
            while (i >= 0 && n[static_cast<size_t>(i)] == '9') {
                n[static_cast<size_t>(i)] = '0';
                --i;
            }
            if (i < 0)
                n.insert(n.begin(), '1');
            else
                ++n[static_cast<size_t>(i)];
        }
    }
    const size_t first = n.find_first_not_of('0');
    return first == std::string::npos ? std::string("0") : n.substr(first);
}

} // namespace ardcard::detail
