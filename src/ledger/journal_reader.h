#pragma once

#include "common/module_state.h"
#include "common/period_totals.h"
#include "ledger/ledger_row.h"

#include <QString>
#include <array>
#include <vector>

namespace ardcard {

// Options of one company's journal read, as the card's check boxes give them.
struct JournalOptions {
    bool onlyOpen = false;     // only lines not fully matched
    int graphDate = 0;         // 0: graph by ValueDate, 1: by DueDate
    bool incNegdiName = false; // also read the counter accounts' names
    bool onlyGraph = false;    // lines go into the period totals only, not the grid
};

// The totals a fetch gathers besides its rows: per currency id (1..22) the
// code seen last ("-" for a Null code) and the signed foreign amounts, and
// the signed shekel amounts per period for the graph.
struct JournalTotals {
    std::array<QString, kCurrencyCount + 1> currencyCodes;
    std::array<double, kCurrencyCount + 1> currencyTotals{};
    PeriodTotals periods;
};

// Everything one company's read needs, taken by value: the read touches no
// state of the thread it runs on.
struct JournalRequest {
    ConnValues conn; // the company's database is `compPath`, not conn.ConnDataBase
    QString compPath;
    QString accountKey; // already cleaned of quotes and commas
    int compId = 0;     // the company's position in the directory list
    JournalOptions options;
    JournalTotals totals; // what earlier companies of the fetch gathered
};

// Where a read's output goes as it is read.
class JournalSink {
public:
    virtual ~JournalSink() = default;
    // The count query's answer, before any line is read.
    virtual void counted(double lines) { (void)lines; }
    // After every fifth line read.
    virtual void progressed(qint64 fetched) { (void)fetched; }
    // Rows in read order (none in a graph-only read) and the totals as they
    // stand after their lines, the request's own included.
    virtual void delivered(std::vector<LedgerRow>&& rows, const JournalTotals& totals) = 0;
};

// Reads the account's journal lines from one company: one grid row per line
// with a running balance from 0, row numbers from 1, the company position
// and the counter account; the lines' amounts go into the totals. Lines are
// delivered in batches. A failure throws Failure, its description naming
// the line; the lines before it have been delivered.
void ReadJournal(const JournalRequest& request, JournalSink& sink);

} // namespace ardcard
