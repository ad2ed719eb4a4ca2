#include "common/formats.h"

#include "common/decimal_digits.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cmath>
#include <cstring>
#include <string_view>
#include <vector>

namespace ardcard {

namespace {

constexpr std::uint64_t kPow10[] = {1ULL,
                                    10ULL,
                                    100ULL,
                                    1000ULL,
                                    10000ULL,
                                    100000ULL,
                                    1000000ULL,
                                    10000000ULL,
                                    100000000ULL,
                                    1000000000ULL,
                                    10000000000ULL,
                                    100000000000ULL,
                                    1000000000000ULL,
                                    10000000000000ULL,
                                    100000000000000ULL,
                                    1000000000000000ULL};

// 5^k for k = 0..27; 5^27 still fits, and a 53-bit mantissa times it fits
// in 128 bits.
constexpr auto kPow5 = [] {
    std::array<std::uint64_t, 28> p{};
    p[0] = 1;
    for (size_t k = 1; k < p.size(); ++k)
        p[k] = p[k - 1] * 5;
    return p;
}();

// GCC's 128-bit integer: the exact product of a mantissa and a power of five.
using Wide = unsigned __int128;

// "00" to "99": two digits per step instead of one.
constexpr char kDigitPairs[] =
    "00010203040506070809101112131415161718192021222324252627282930313233"
    "34353637383940414243444546474849505152535455565758596061626364656667"
    "6869707172737475767778798081828384858687888990919293949596979899";

// Digits of n at the end of a buffer; returns where they start. Inline in
// its few callers: a row of a large file formats eight numbers or more.
[[gnu::always_inline]] inline char* digitsBackwards(char* end, unsigned long long n) {
    // Four digits a step: each division waits for the one before it, so
    // fewer, wider steps make a shorter chain; the two pairs of a step are
    // independent, and 32-bit arithmetic is quicker than 64-bit.
    while (n >= 10000) {
        const unsigned long long q = n / 10000;
        const auto four = static_cast<unsigned>(n - q * 10000);
        n = q;
        const unsigned high = four / 100;
        const unsigned low = four - high * 100;
        end -= 4;
        std::memcpy(end, &kDigitPairs[high * 2], 2);
        std::memcpy(end + 2, &kDigitPairs[low * 2], 2);
    }
    auto m = static_cast<unsigned>(n);
    if (m >= 100) {
        const unsigned low = m % 100;
        m /= 100;
        end -= 2;
        std::memcpy(end, &kDigitPairs[low * 2], 2);
    }
    if (m >= 10) {
        end -= 2;
        std::memcpy(end, &kDigitPairs[m * 2], 2);
    } else {
        *--end = static_cast<char>('0' + m);
    }
    return end;
}

// How many digits n has, so that they can be written in place from the
// end without a scratch and a copy: the bit length gives the count or one
// more (1233 / 4096 is just below log10 2), and one compare settles it.
size_t decimalLength(unsigned long long n) {
    static constexpr auto kPowers = [] {
        std::array<unsigned long long, 20> p{};
        p[0] = 1;
        for (size_t k = 1; k < p.size(); ++k)
            p[k] = p[k - 1] * 10;
        return p;
    }();
    const unsigned long long m = n | 1; // 0 has one digit, as 1 has
    const auto guess = static_cast<size_t>(std::bit_width(m) * 1233) >> 12; // at most 19
    return guess + 1 - (m < kPowers[guess] ? 1 : 0);
}

// The grouped text of `scaled` (the value times 10^decimals) at the end of
// a buffer; returns where it starts. The integer part gets at least one
// digit: 0.05 is "0.05", not ".05".
char* groupedBackwards(char* end, std::uint64_t scaled, int decimals, bool negative) {
    for (int i = 0; i < decimals; ++i) {
        *--end = static_cast<char>('0' + scaled % 10);
        scaled /= 10;
    }
    if (decimals > 0)
        *--end = '.';
    for (int group = 0;; ++group) {
        if (group > 0)
            *--end = ',';
        if (scaled < 1000) {
            end = digitsBackwards(end, scaled);
            break;
        }
        const auto three = static_cast<unsigned>(scaled % 1000);
        scaled /= 1000;
        *--end = static_cast<char>('0' + three % 10);
        *--end = kDigitPairs[three / 10 * 2 + 1];
        *--end = kDigitPairs[three / 10 * 2];
    }
    if (negative)
        *--end = '-';
    return end;
}

// `digits` is the value times 10^decimals without leading zeros ("0" for
// zero), any length; writes it with grouped integer digits and the point.
std::size_t writeGrouped(char* out, std::string_view digits, int decimals, bool negative) {
    const auto places = static_cast<size_t>(decimals);
    char* p = out;
    if (negative)
        *p++ = '-';
    const size_t padding = digits.size() < places + 1 ? places + 1 - digits.size() : 0;
    const size_t total = digits.size() + padding;
    const size_t intLen = total - places;
    auto digitAt = [&](size_t i) { return i < padding ? '0' : digits[i - padding]; };
    for (size_t i = 0; i < intLen; ++i) {
        if (i > 0 && (intLen - i) % 3 == 0)
            *p++ = ',';
        *p++ = digitAt(i);
    }
    if (places > 0) {
        *p++ = '.';
        for (size_t i = intLen; i < total; ++i)
            *p++ = digitAt(i);
    }
    return static_cast<size_t>(p - out);
}

// Room writeGrouped needs for `digitCount` digits.
size_t groupedRoom(size_t digitCount, int decimals) {
    const size_t total = std::max(digitCount, static_cast<size_t>(decimals) + 1);
    return total + total / 3 + 3;
}

// The common case in plain double arithmetic: below 1e7 with at most two
// decimals, the 15-digit form of the value times 10^decimals lies within
// 0.5e-6 of the exact product (half a unit of the 15th digit is at most
// 0.5 x 10^(6 - 14 + 2)), and the double product within 1.2e-7 of that
// (2^-53 of a number below 1e9). So when the product's fraction is at least
// 1e-6 away from one half, both round to the same integer, and no exact
// half can be involved. Nearer a half the exact way below decides.
bool quickRoundedScaled(double magnitude, int decimals, std::uint64_t& scaled) {
    if (magnitude >= 1e7 || decimals > 2)
        return false;
    const double product = magnitude * static_cast<double>(kPow10[decimals]);
    const double whole = std::floor(product);
    const double fraction = product - whole; // exact, as any double's fraction is
    if (std::fabs(fraction - 0.5) < 1e-6)
        return false;
    scaled = static_cast<std::uint64_t>(whole) + (fraction > 0.5 ? 1 : 0);
    return true;
}

} // namespace

bool detail::fastRoundedScaled(double value, int decimals, std::uint64_t& scaled) {
    if (decimals < 0 || decimals > 3)
        return false;
    const double magnitude = std::fabs(value);
    if (!(magnitude < 1e13)) // NaN and infinities too
        return false;
    // Below 1e-6 the 15-digit form is at most 0.000001, which is 0 at three
    // decimals.
    if (magnitude < 1e-6) {
        scaled = 0;
        return true;
    }
    if (quickRoundedScaled(magnitude, decimals, scaled))
        return true;
    // magnitude = mantissa x 2^(exp2 - 53), exactly; magnitude is normal here.
    const auto bits = std::bit_cast<std::uint64_t>(magnitude);
    const std::uint64_t mantissa =
        (bits & ((std::uint64_t{1} << 52) - 1)) | (std::uint64_t{1} << 52);
    const int exp2 = static_cast<int>(bits >> 52) - 1022;

    // The 15 significant digits are magnitude x 10^k rounded to an integer,
    // k = 14 - e where 10^e <= magnitude < 10^(e+1). Guess e from the binary
    // exponent (1233 / 4096 is just below log10 2; the guess may be one
    // short) and correct it on the exact product,
    // magnitude x 10^k = mantissa x 5^k / 2^shift.
    int e = ((exp2 - 1) * 1233) >> 12;
    int k = 0;
    int shift = 0;
    Wide product = 0;
    Wide whole = 0;
    for (int attempt = 0; attempt < 3; ++attempt) {
        k = 14 - e;
        shift = 53 - exp2 - k;
        if (k < 0 || k >= static_cast<int>(kPow5.size()) || shift <= 0 || shift >= 127)
            return false;
        product = static_cast<Wide>(mantissa) * kPow5[static_cast<size_t>(k)];
        whole = product >> shift;
        if (whole >= kPow10[15])
            ++e;
        else if (whole < kPow10[14])
            --e;
        else
            break;
    }
    if (whole < kPow10[14] || whole >= kPow10[15])
        return false;

    // The decimal text of the value rounds the exact binary value to nearest,
    // an exact tie to the even digit.
    const Wide rest = product & ((static_cast<Wide>(1) << shift) - 1);
    const Wide half = static_cast<Wide>(1) << (shift - 1);
    auto digits15 = static_cast<std::uint64_t>(whole);
    if (rest > half || (rest == half && (digits15 & 1) != 0))
        ++digits15; // may become 10^15: the same value with one more digit

    // Then the 15-digit value rounds half away from zero to `decimals`
    // places: scaled = digits15 x 10^(decimals - k).
    const int drop = k - decimals;
    if (drop <= 0) {
        scaled = digits15 * kPow10[static_cast<size_t>(-drop)];
    } else if (drop > 15) {
        scaled = 0; // digits15 <= 10^15 is below half of 10^drop
    } else {
        const std::uint64_t unit = kPow10[static_cast<size_t>(drop)];
        scaled = digits15 / unit;
        if ((digits15 % unit) * 2 >= unit)
            ++scaled;
    }
    return true;
}

std::size_t FormatGroupedTo(char* out, double value, int decimals, bool emptyWhenZero) {
    std::uint64_t scaled = 0;
    if (detail::fastRoundedScaled(value, decimals, scaled)) {
        if (scaled == 0 && emptyWhenZero)
            return 0;
        char buf[40]; // 20 digits, 6 commas, sign and point
        char* const end = buf + sizeof buf;
        const char* first = groupedBackwards(end, scaled, decimals, value < 0 && scaled != 0);
        const auto len = static_cast<size_t>(end - first);
        std::memcpy(out, first, len);
        return len;
    }
    const detail::DecimalDigits d = detail::toDecimalDigits(value);
    const std::string n = detail::roundedScaled(d, decimals);
    const bool zero = n == "0";
    if (zero && emptyWhenZero)
        return 0;
    return writeGrouped(out, n, decimals, d.negative && !zero);
}

std::size_t FormatMoneyPlainTo(char* out, double value) {
    std::uint64_t scaled = 0;
    // Most amounts are below ten million: the quick rounding straight away,
    // as fastRoundedScaled would take it, without its general checks.
    const double magnitude = std::fabs(value);
    const bool quick = magnitude >= 1e-6 && quickRoundedScaled(magnitude, 2, scaled);
    if (!quick && !detail::fastRoundedScaled(value, 2, scaled)) {
        // Beyond the fast range (13 digits and more): the grouped text with
        // its commas taken out, rare enough not to matter.
        const size_t len = FormatGroupedTo(out, value, 2);
        char* const end = std::remove(out, out + len, ',');
        return static_cast<size_t>(end - out);
    }
    // Sign, whole units, point and cents, written in place.
    const bool negative = value < 0 && scaled != 0;
    const std::uint64_t units = scaled / 100;
    const auto cents = static_cast<size_t>(scaled % 100) * 2;
    const size_t len = (negative ? 1 : 0) + decimalLength(units) + 3;
    char* const end = out + len;
    digitsBackwards(end - 3, units);
    end[-3] = '.';
    end[-2] = kDigitPairs[cents];
    end[-1] = kDigitPairs[cents + 1];
    if (negative)
        *out = '-';
    return len;
}

QString FormatGrouped(double value, int decimals, bool emptyWhenZero) {
    // A negative count of decimals has no text of its own: it reads as none.
    decimals = std::max(decimals, 0);
    if (decimals <= 3) {
        char buf[kNumberTextMax];
        const size_t len = FormatGroupedTo(buf, value, decimals, emptyWhenZero);
        return QString::fromLatin1(buf, static_cast<qsizetype>(len));
    }
    std::vector<char> buf(groupedRoom(330 + static_cast<size_t>(decimals), decimals));
    const size_t len = FormatGroupedTo(buf.data(), value, decimals, emptyWhenZero);
    return QString::fromLatin1(buf.data(), static_cast<qsizetype>(len));
}

QString FormatMoney(double value) {
    return FormatGrouped(value, 2);
}
QString FormatQuantity(double value) {
    return FormatGrouped(value, 3);
}
QString FormatWhole(double value) {
    return FormatGrouped(value, 0, true);
}

std::size_t FormatIntegerTo(char* out, long long value) {
    if (value >= 0)
        return FormatUnsignedTo(out, static_cast<unsigned long long>(value));
    *out = '-';
    // Negate in unsigned arithmetic so that the smallest value has a magnitude.
    return 1 + FormatUnsignedTo(out + 1, 0ULL - static_cast<unsigned long long>(value));
}

std::size_t FormatUnsignedTo(char* out, unsigned long long value) {
    const size_t len = decimalLength(value);
    digitsBackwards(out + len, value);
    return len;
}

std::size_t PlainWholeTo(char* out, double value) {
    if (!(std::fabs(value) < 1e15) || value != std::trunc(value))
        return 0;
    return FormatIntegerTo(out, static_cast<long long>(value));
}

namespace {
// Year, month and day of a Julian day in the proleptic Gregorian calendar
// that QDate uses (days from 1 March of year 0 counted in 400-year eras):
// plain arithmetic where QDate::getDate goes through the calendar system.
void civilFromJulianDay(qint64 jd, int& year, int& month, int& day) {
    const qint64 z = jd - 1721120; // days since 0000-03-01
    const qint64 era = (z >= 0 ? z : z - 146096) / 146097;
    const qint64 doe = z - era * 146097;                                      // [0, 146096]
    const qint64 yoe = (doe - doe / 1460 + doe / 36524 - doe / 146096) / 365; // [0, 399]
    const qint64 doy = doe - (365 * yoe + yoe / 4 - yoe / 100);               // [0, 365]
    const qint64 mp = (5 * doy + 2) / 153;                                    // March = 0
    day = static_cast<int>(doy - (153 * mp + 2) / 5 + 1);
    month = static_cast<int>(mp < 10 ? mp + 3 : mp - 9);
    year = static_cast<int>(yoe + era * 400 + (month <= 2 ? 1 : 0));
}

// "dd/mm/yy" or "dd/mm/yyyy" for years 1000 to 9999 without the locale
// machinery of QDate::toString, which costs more than the rest of a grid row.
std::size_t quickDate(char* out, QDate date, bool longYear) {
    if (!date.isValid())
        return 0;
    int y = 0;
    int m = 0;
    int d = 0;
    civilFromJulianDay(date.toJulianDay(), y, m, d);
    if (y < 1000 || y > 9999)
        return 0;
    char* p = out;
    *p++ = kDigitPairs[d * 2];
    *p++ = kDigitPairs[d * 2 + 1];
    *p++ = '/';
    *p++ = kDigitPairs[m * 2];
    *p++ = kDigitPairs[m * 2 + 1];
    *p++ = '/';
    if (longYear) {
        *p++ = kDigitPairs[y / 100 * 2];
        *p++ = kDigitPairs[y / 100 * 2 + 1];
    }
    *p++ = kDigitPairs[y % 100 * 2];
    *p++ = kDigitPairs[y % 100 * 2 + 1];
    return static_cast<size_t>(p - out);
}
} // namespace

std::size_t FormatShortDateTo(char* out, QDate date) {
    return quickDate(out, date, false);
}

QString FormatShortDate(QDate date) {
    char buf[8];
    if (const size_t len = quickDate(buf, date, false))
        return QString::fromLatin1(buf, static_cast<qsizetype>(len));
    return date.toString(QStringLiteral("dd/MM/yy"));
}
QString FormatLongDate(QDate date) {
    char buf[10];
    if (const size_t len = quickDate(buf, date, true))
        return QString::fromLatin1(buf, static_cast<qsizetype>(len));
    return date.toString(QStringLiteral("dd/MM/yyyy"));
}

std::size_t FormatShortDateTo(char* out, QDate date, ShortDateMemo& memo) {
    const qint64 day = date.toJulianDay();
    if (memo.held && memo.day == day) {
        std::memcpy(out, memo.text, sizeof memo.text);
        return sizeof memo.text;
    }
    const std::size_t len = FormatShortDateTo(out, date);
    memo.held = len == sizeof memo.text;
    if (memo.held) {
        memo.day = day;
        std::memcpy(memo.text, out, sizeof memo.text);
    }
    return len;
}

} // namespace ardcard
