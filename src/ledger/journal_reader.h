#pragma once

#include <QString>

namespace ardcard {

class LedgerModel;

// Options of one company's journal read, as the card's check boxes give them.
struct JournalOptions {
    bool onlyOpen = false;     // only lines not fully matched
    int graphDate = 0;         // 0: graph by ValueDate, 1: by DueDate
    bool incNegdiName = false; // also read the counter accounts' names
    bool onlyGraph = false;    // lines go into the period totals only, not the grid
};

// The progress bar the read moves: an outline whose width is read and a fill
// whose width is set. The card puts its two frames behind this; the read
// itself knows nothing of widgets.
class ProgressSink {
public:
    virtual ~ProgressSink() = default;
    virtual int frameWidth() const = 0;
    virtual void setFillWidth(int width) = 0;
};

// A progress bar nobody sees.
class NoProgress final : public ProgressSink {
public:
    int frameWidth() const override { return 0; }
    void setFillWidth(int) override {}
};

// Reads one account's journal lines from one company directory (`CompPath`
// becomes the database of the connection string built from
// moduleState().conn) and appends a grid row per line to `ledger`, with a
// running balance that starts at 0 for this call, the row's company position
// `pCompID` and its counter account. Signed foreign amounts accumulate into
// moduleState().CurrencyTotals per currency id (1..22) and the signed shekel
// amounts into moduleState().periods.
//
// Returns -1 when the query ran (with or without lines), 0 when the account
// is hidden in this company (nothing read, `failure` left empty) or the read
// failed: then `failure` holds a description for the caller to show, and the
// rows and totals gathered before the failure stay.
int ReadTransactions7(const QString& CompPath, const QString& pAccountKey, int pCompID,
                      const JournalOptions& options, LedgerModel& ledger, ProgressSink& progress,
                      QString* failure = nullptr);

} // namespace ardcard
