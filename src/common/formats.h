#pragma once

#include <QDate>
#include <QString>
#include <cstddef>

namespace ardcard {

// Numbers are shown the way the host product shows them: the value is first
// taken at 15 significant digits (the precision of its text conversions),
// then rounded half away from zero to the places shown.

// "##,##0.00" (also written "#,##0.00"): thousands grouped with ",", exactly
// two decimals, "-" before a negative value.
QString FormatMoney(double value);
// "#,##0.000": as FormatMoney with three decimals.
QString FormatQuantity(double value);
// "###,###,###": a whole number with grouping; a value whose rounded
// magnitude is 0 prints no digits at all.
QString FormatWhole(double value);
// Grouped fixed-point text with `decimals` decimals (the shared engine).
QString FormatGrouped(double value, int decimals, bool emptyWhenZero = false);

// "dd/mm/yy" and "dd/mm/yyyy".
QString FormatShortDate(QDate date);
QString FormatLongDate(QDate date);

// The same texts as ASCII in a caller's buffer, for the ledger's cells,
// which the writers read by the million. `out` holds at least
// kNumberTextMax chars; each returns the length written.
//
// Room for any grouped number with up to three decimals: the 309 integer
// digits of the largest double, their 102 commas, a sign and the decimals.
inline constexpr std::size_t kNumberTextMax = 420;
// Without `thousands` the number has no grouping commas (the CSV file's
// fields may not carry its separator).
std::size_t FormatGroupedTo(char* out, double value, int decimals, bool thousands = true);
inline std::size_t FormatMoneyTo(char* out, double value, bool thousands = true) {
    return FormatGroupedTo(out, value, 2, thousands);
}
// FormatShortDate's text for years 1 to 9999; 0 for an invalid date or any
// other year, whose text the caller takes from FormatShortDate.
std::size_t FormatShortDateTo(char* out, QDate date);
// The decimal text of a whole number (what QString::number gives).
std::size_t FormatIntegerTo(char* out, long long value);
// PlainNumber's text for a whole number below 1e15 in magnitude, where its
// 15 significant digits are the number itself; 0 for any other value, whose
// text the caller takes from PlainNumber.
std::size_t PlainWholeTo(char* out, double value);

} // namespace ardcard
