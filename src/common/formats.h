#pragma once

#include <QDate>
#include <QString>

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

} // namespace ardcard
