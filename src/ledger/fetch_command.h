#pragma once

#include "ledger/journal_reader.h"

#include <QString>
#include <functional>

namespace ardcard {

class LedgerModel;

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
