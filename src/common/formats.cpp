#include "common/formats.h"

#include "common/decimal_digits.h"

#include <algorithm>
#include <charconv>
#include <chrono>
#include <cmath>
#include <string>

namespace ardcard {

namespace {

// Writes the grouped text into a buffer of `room` chars when it fits;
// returns its length (0 with emptyWhenZero for a value that rounds to zero),
// or the room it needs, above `room`, when it does not fit. The integer part
// gets at least one digit: 0.05 is "0.05", not ".05".
std::size_t grouped(char* out, std::size_t room, double value, int decimals, bool emptyWhenZero,
                    bool thousands = true) {
    const detail::SignificantDigits d = detail::ToSignificantDigits(value);
    const detail::Scaled scaled = detail::RoundedScaled(d, decimals);
    if (scaled.scaled == 0 && emptyWhenZero)
        return 0;
    // The value times 10^decimals: these digits, then scaled.zeros zeros.
    char text[24];
    const auto length =
        static_cast<std::size_t>(std::to_chars(text, text + sizeof text, scaled.scaled).ptr - text);
    const auto places = static_cast<std::size_t>(decimals);
    const std::size_t digits =
        std::max(length + static_cast<std::size_t>(scaled.zeros), places + 1);
    const std::size_t padding = digits - length - static_cast<std::size_t>(scaled.zeros);
    const std::size_t intLen = digits - places;
    const std::size_t needed = digits + (thousands ? (intLen - 1) / 3 : 0) + 2;
    if (needed > room)
        return needed;
    auto digitAt = [&](std::size_t i) {
        if (i < padding)
            return '0';
        i -= padding;
        return i < length ? text[i] : '0';
    };
    char* p = out;
    if (d.negative && scaled.scaled != 0)
        *p++ = '-';
    for (std::size_t i = 0; i < intLen; ++i) {
        if (thousands && i > 0 && (intLen - i) % 3 == 0)
            *p++ = ',';
        *p++ = digitAt(i);
    }
    if (places > 0) {
        *p++ = '.';
        for (std::size_t i = intLen; i < digits; ++i)
            *p++ = digitAt(i);
    }
    return static_cast<std::size_t>(p - out);
}

std::size_t dateTo(char* out, QDate date, bool longYear) {
    if (!date.isValid())
        return 0;
    // The standard library's civil calendar is the proleptic Gregorian one
    // that QDate uses, counted from 1970-01-01 (Julian day 2440588).
    const std::chrono::year_month_day ymd{
        std::chrono::sys_days{std::chrono::days{date.toJulianDay() - 2440588}}};
    // Year 0 there is 1 BC, which QDate calls -1.
    const int year = static_cast<int>(ymd.year());
    if (year < 1 || year > 9999)
        return 0;
    const auto two = [](char* p, unsigned n) {
        p[0] = static_cast<char>('0' + n / 10);
        p[1] = static_cast<char>('0' + n % 10);
    };
    two(out, static_cast<unsigned>(ymd.day()));
    out[2] = '/';
    two(out + 3, static_cast<unsigned>(ymd.month()));
    out[5] = '/';
    const auto y = static_cast<unsigned>(year);
    if (!longYear) {
        two(out + 6, y % 100);
        return 8;
    }
    two(out + 6, y / 100);
    two(out + 8, y % 100);
    return 10;
}

QString dateText(QDate date, bool longYear) {
    // QDate::toString goes through the locale machinery, which costs more
    // than the rest of a grid row; years it cannot write here get it still.
    char buf[10];
    if (const std::size_t len = dateTo(buf, date, longYear))
        return QString::fromLatin1(buf, static_cast<qsizetype>(len));
    return date.toString(longYear ? QStringLiteral("dd/MM/yyyy") : QStringLiteral("dd/MM/yy"));
}

} // namespace

std::size_t FormatGroupedTo(char* out, double value, int decimals, bool thousands) {
    return grouped(out, kNumberTextMax, value, std::clamp(decimals, 0, 3), false, thousands);
}

QString FormatGrouped(double value, int decimals, bool emptyWhenZero) {
    // A negative count of decimals has no text of its own: it reads as none.
    decimals = std::max(decimals, 0);
    char buf[kNumberTextMax];
    const std::size_t len = grouped(buf, sizeof buf, value, decimals, emptyWhenZero);
    if (len <= sizeof buf)
        return QString::fromLatin1(buf, static_cast<qsizetype>(len));
    std::string big(len, '\0'); // many decimals, or a very large value
    big.resize(grouped(big.data(), big.size(), value, decimals, emptyWhenZero));
    return QString::fromLatin1(big.data(), static_cast<qsizetype>(big.size()));
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

QString FormatShortDate(QDate date) {
    return dateText(date, false);
}
QString FormatLongDate(QDate date) {
    return dateText(date, true);
}

std::size_t FormatShortDateTo(char* out, QDate date) {
    return dateTo(out, date, false);
}

std::size_t FormatIntegerTo(char* out, long long value) {
    return static_cast<std::size_t>(std::to_chars(out, out + kNumberTextMax, value).ptr - out);
}

std::size_t PlainWholeTo(char* out, double value) {
    if (!(std::fabs(value) < 1e15) || value != std::trunc(value))
        return 0;
    return FormatIntegerTo(out, static_cast<long long>(value));
}

} // namespace ardcard
