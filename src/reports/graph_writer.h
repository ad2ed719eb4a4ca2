#pragma once

#include <QString>

namespace ardcard {
class PeriodTotals;
}

namespace ardcard::reports {

// Whether the graph of that kind (0 week, 1 month, 2 quarter) has a bar to
// draw: some period of some year holds a non-zero net amount.
bool GraphHasBars(const PeriodTotals& totals, int kind);

// The income/expense graph page: one horizontal bar per period with a
// non-zero net amount, newest year first and, within a year, the last period
// first; each bar as wide as its amount relative to the largest amount of
// all years, green above zero and pink below, with the amount inside.
//
// When there is nothing to draw nothing is written and an earlier file is
// left alone; returns whether the page was written. Failures throw Failure
// with the file closed. `shortName` is the company's short name as stored.
bool WriteGraph(const QString& path, const PeriodTotals& totals, int kind, const QString& shortName,
                const QString& accountKey, const QString& accountName);

} // namespace ardcard::reports
