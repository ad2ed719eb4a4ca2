#include "common/period_totals.h"

#include <algorithm>

namespace ardcard {

void PeriodTotals::clear() {
    years_.clear();
}

int PeriodTotals::weekOfYear(QDate date) {
    const QDate first(date.year(), 1, 1);
    const int firstWeekday = first.dayOfWeek() % 7; // Sunday 0 .. Saturday 6
    return (date.dayOfYear() - 1 + firstWeekday) / 7 + 1;
}

void PeriodTotals::add(QDate date, double amount) {
    Year& year = years_[date.year()];
    const auto month = static_cast<size_t>(date.month());
    year.weeks[static_cast<size_t>(weekOfYear(date))] += amount;
    year.months[month] += amount;
    year.quarters[(month - 1) / 3 + 1] += amount;
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

// The cells of one kind (index 1..count), or null for an unknown kind.
const double* PeriodTotals::cells(const Year& year, int kind, int* count) {
    *count = periodsPerYear(kind);
    switch (kind) {
    case Week:
        return year.weeks.data();
    case Month:
        return year.months.data();
    case Quarter:
        return year.quarters.data();
    default:
        return nullptr;
    }
}

double PeriodTotals::value(int kind, int year, int period) const {
    const auto it = years_.find(year);
    int count = 0;
    const double* values = it == years_.end() ? nullptr : cells(it->second, kind, &count);
    return values && period >= 1 && period <= count ? values[period] : 0.0;
}

std::vector<int> PeriodTotals::yearsDescending(int kind) const {
    std::vector<int> out;
    for (const auto& [number, year] : years_) {
        int count = 0;
        const double* values = cells(year, kind, &count);
        for (int period = 1; values && period <= count; ++period) {
            if (values[period] != 0.0) {
                out.push_back(number);
                break;
            }
        }
    }
    std::reverse(out.begin(), out.end());
    return out;
}

} // namespace ardcard
