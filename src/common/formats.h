#pragma once

#include <QDate>
#include <QString>
#include <cstddef>
#include <cstdint>

namespace ardcard {

// "##,##0.00" (also written "#,##0.00"): thousands grouped with ",", exactly
// two decimals, "-" before a negative value; halves round away from zero.
QString FormatMoney(double value);
// "#,##0.000": as FormatMoney with three decimals.
QString FormatQuantity(double value);
// "###,###,###": a whole number with grouping, halves away from zero; a value
// whose rounded magnitude is 0 prints no digits at all.
QString FormatWhole(double value);
// Grouped fixed-point text with `decimals` decimals (the shared engine).
QString FormatGrouped(double value, int decimals, bool emptyWhenZero = false);

// "dd/mm/yy" and "dd/mm/yyyy".
QString FormatShortDate(QDate date);
QString FormatLongDate(QDate date);

// The same texts as ASCII in a caller's buffer, for writers that format
// millions of cells and should not build a string for each. `out` holds at
// least kNumberTextMax chars; each returns the length written.
//
// Room for any grouped number: the 309 integer digits of the largest double,
// their 102 commas, a sign, a point and three decimals.
inline constexpr std::size_t kNumberTextMax = 420;
std::size_t FormatGroupedTo(char* out, double value, int decimals, bool emptyWhenZero = false);
inline std::size_t FormatMoneyTo(char* out, double value) {
    return FormatGroupedTo(out, value, 2);
}
// FormatMoney's text without its thousands commas, for the CSV file, whose
// fields may not carry the separator: the digits are produced without the
// commas rather than grouped and then dropped.
std::size_t FormatMoneyPlainTo(char* out, double value);
// FormatShortDate's text for years 1000 to 9999 (8 chars); 0 for any other
// date, whose text the caller takes from FormatShortDate.
std::size_t FormatShortDateTo(char* out, QDate date);

// The last date a column wrote: rows of one day follow one another, so
// most dates are copied, not computed.
struct ShortDateMemo {
    qint64 day = 0;
    char text[8] = {};
    bool held = false;
};
// FormatShortDateTo through the column's memo (0 as FormatShortDateTo).
std::size_t FormatShortDateTo(char* out, QDate date, ShortDateMemo& memo);
// The decimal text of a whole number, "-" first when negative (what
// QString::number gives).
std::size_t FormatIntegerTo(char* out, long long value);
std::size_t FormatUnsignedTo(char* out, unsigned long long value);
// PlainNumber's text for a whole number below 1e15 in magnitude, where its
// 15 significant digits are the number itself; 0 for any other value, whose
// text the caller takes from PlainNumber.
std::size_t PlainWholeTo(char* out, double value);

namespace detail {
// |value| x 10^decimals rounded the way the formats round (to 15 significant
// digits first, then half away from zero to `decimals` places), computed
// exactly in integers for |value| < 1e13 and decimals 0 to 3. Returns false
// for anything else, which goes the general decimal-digit way.
bool fastRoundedScaled(double value, int decimals, std::uint64_t& scaled);
} // namespace detail

} // namespace ardcard
