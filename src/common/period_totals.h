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
    // The cells of one year; a fetch adds line after line of the same year.
    struct YearCells {
        int year = 0;
        qint64 firstDay = 0;     // Julian day of 1 January
        int firstWeekday = 0;    // Sunday 0 .. Saturday 6
        double* weeks = nullptr; // index 1..54
        double* months = nullptr;
        double* quarters = nullptr;
    };
    YearCells& cellsOf(int year);

    std::map<int, std::array<double, 55>> weeks_;   // index 1..54
    std::map<int, std::array<double, 13>> months_;  // index 1..12
    std::map<int, std::array<double, 5>> quarters_; // index 1..4
    YearCells last_; // map entries never move, so their addresses stay valid
};

} // namespace ardcard
