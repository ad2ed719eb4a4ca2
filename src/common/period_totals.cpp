#include "common/period_totals.h"

namespace ardcard {

void PeriodTotals::clear() {
    weeks_.clear();
    months_.clear();
    quarters_.clear();
    last_ = YearCells();
}

PeriodTotals::YearCells& PeriodTotals::cellsOf(int year) {
    if (last_.weeks && last_.year == year)
        return last_;
    const QDate first(year, 1, 1);
    last_.year = year;
    last_.firstDay = first.toJulianDay();
    last_.firstWeekday = first.dayOfWeek() % 7;
    last_.weeks = weeks_[year].data();
    last_.months = months_[year].data();
    last_.quarters = quarters_[year].data();
    return last_;
}

int PeriodTotals::weekOfYear(QDate date) {
    const QDate first(date.year(), 1, 1);
    const int firstWeekday = first.dayOfWeek() % 7; // Sunday 0 .. Saturday 6
    return (date.dayOfYear() - 1 + firstWeekday) / 7 + 1;
}

void PeriodTotals::add(QDate date, double amount) {
    int year = 0;
    int month = 0;
    date.getDate(&year, &month, nullptr);
    YearCells& cells = cellsOf(year);
    const qint64 dayOfYear = date.toJulianDay() - cells.firstDay + 1;
    cells.weeks[(dayOfYear - 1 + cells.firstWeekday) / 7 + 1] += amount;
    cells.months[month] += amount;
    cells.quarters[(month - 1) / 3 + 1] += amount;
}

int PeriodTotals::periodsPerYear(int kind) {
    switch (kind) {
    case Week:
        return 54;
    case Month:
        return 12;
    case Quarter:
        return 4;
    default:
        return 0;
    }
}

namespace {
template <typename Map> double cell(const Map& map, int year, int period) {
    const auto it = map.find(year);
    if (it == map.end() || period < 1 || period >= static_cast<int>(it->second.size()))
        return 0.0;
    return it->second[period];
}

template <typename Map> std::vector<int> years(const Map& map) {
    std::vector<int> out;
    for (auto it = map.rbegin(); it != map.rend(); ++it) {
        for (double v : it->second) {
            if (v != 0.0) {
                out.push_back(it->first);
                break;
            }
        }
    }
    return out;
}
} // namespace

double PeriodTotals::value(int kind, int year, int period) const {
    switch (kind) {
    case Week:
        return cell(weeks_, year, period);
    case Month:
        return cell(months_, year, period);
    case Quarter:
        return cell(quarters_, year, period);
    default:
        return 0.0;
    }
}

std::vector<int> PeriodTotals::yearsDescending(int kind) const {
    switch (kind) {
    case Week:
        return years(weeks_);
    case Month:
        return years(months_);
    case Quarter:
        return years(quarters_);
    default:
        return {};
    }
}

} // namespace ardcard
