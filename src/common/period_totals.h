#pragma once

#include <QDate>
#include <array>
#include <map>
#include <vector>

namespace ardcard {

// Net signed shekel amounts per week, month and quarter of every year that a
// fetched line carries. Years are not bounded: a map holds only the years seen.
class PeriodTotals {
public:
    enum Kind { Week = 0, Month = 1, Quarter = 2 };

    void clear();
    void add(QDate date, double amount);

    // Number of periods per year for a graph kind (54, 12, 4), 0 for any other kind.
    static int periodsPerYear(int kind);
    // Week of the year: weeks start on Sunday and week 1 holds 1 January.
    static int weekOfYear(QDate date);

    double value(int kind, int year, int period) const;
    // Years holding at least one non-zero cell of that kind, newest first.
    std::vector<int> yearsDescending(int kind) const;

private:
    struct Year {
        std::array<double, 55> weeks{}; // index 1..54
        std::array<double, 13> months{};
        std::array<double, 5> quarters{};
    };
    static const double* cells(const Year& year, int kind, int* count);

    std::map<int, Year> years_;
};

} // namespace ardcard
