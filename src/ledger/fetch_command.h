#pragma once

#include "ledger/journal_reader.h"

#include <QString>
#include <functional>

namespace ardcard {

class LedgerModel;

// The progress bar a read moves: an outline whose width is read and a fill
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
// moduleState().conn) into `ledger`, and the lines' amounts into
// moduleState()'s currency and period totals (ReadJournal).
//
// Returns -1 when the query ran (with or without lines), 0 when the account
// is hidden in this company (nothing read, `failure` left empty) or the read
// failed: then `failure` holds a description for the caller to show, and the
// rows and totals gathered before the failure stay.
int ReadTransactions7(const QString& CompPath, const QString& pAccountKey, int pCompID,
                      const JournalOptions& options, LedgerModel& ledger, ProgressSink& progress,
                      QString* failure = nullptr);

// What the fetch asks of the screen that runs it. The card fills this from
// its check boxes and its own per-directory read (which shows a failure
// itself); tests fill it with plain values.
struct FetchSources {
    // Read once per fetch: whether counter-account names are read.
    std::function<bool()> includeCounterNames;
    // Read anew before each directory (the clerk may change them at a
    // yield): only open lines, graph date, graph only. Its incNegdiName is
    // replaced by the value read once.
    std::function<JournalOptions()> directoryOptions;
    // Reads one directory; the result is not used: a directory that failed
    // has reported it and the fetch goes on with the next one.
    std::function<int(const QString& compPath, const QString& accountKey, int compId,
                      const JournalOptions& options)>
        readDirectory;
};

// Lays the ledger data out afresh: no rows, period totals and currency
// totals zeroed. (Currency codes stay: an id keeps the last code seen.)
void InitLedgerData(LedgerModel& ledger);

// Reads the account from every directory named in `CompPath` (";" or ","
// separated; the list and count land in moduleState()), in list order, with
// company positions 1, 2, ...; yields to the event loop after each directory
// and stops when moduleState().StopFlag is then set. Appends to what the
// ledger holds. Returns the cleaned account key (quotes and commas removed).
QString ReadAllTransactions(const QString& CompPath, const QString& pAccountKey,
                            const FetchSources& sources);

} // namespace ardcard
