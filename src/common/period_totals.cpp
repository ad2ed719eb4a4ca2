#include "common/period_totals.h"

namespace ardcard {

void PeriodTotals::clear() {
    weeks_.clear();
    months_.clear();
    quarters_.clear();
}

int PeriodTotals::weekOfYear(QDate date) {
    const QDate first(date.year(), 1, 1);
    const int firstWeekday = first.dayOfWeek() % 7; // Sunday 0 .. Saturday 6
    return (date.dayOfYear() - 1 + firstWeekday) / 7 + 1;
}

void PeriodTotals::add(QDate date, double amount) {
    const int year = date.year();
    weeks_[year][weekOfYear(date)] += amount;
    months_[year][date.month()] += amount;
    quarters_[year][(date.month() - 1) / 3 + 1] += amount;
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
