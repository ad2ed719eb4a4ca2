#include "ledger/fetch_command.h"

#include "common/module_state.h"
#include "common/text_helpers.h"
#include "ledger/ledger_model.h"

#include <QCoreApplication>

namespace ardcard {

void InitLedgerData(LedgerModel& ledger) {
    ledger.clear();
    ModuleState& state = moduleState();
    state.periods.clear();
    // The currency totals cover the whole fetch, every company of it.
    state.CurrencyTotals.fill(0.0);
}

QString ReadAllTransactions(const QString& CompPath, const QString& pAccountKey,
                            const FetchSources& sources) {
    ModuleState& state = moduleState();
    state.CompanyDirCount = SplitCompanyDirs(CompPath, state.CompanyDirList);
    // A text naming no directory leaves the old list in place; the count
    // alone decides what is read.
    const QString accountKey = StripQuotes(pAccountKey);
    const bool counterNames = sources.includeCounterNames ? sources.includeCounterNames() : false;

    for (int i = 1; i <= state.CompanyDirCount; ++i) {
        JournalOptions options =
            sources.directoryOptions ? sources.directoryOptions() : JournalOptions{};
        options.incNegdiName = counterNames;
        if (sources.readDirectory)
            sources.readDirectory(companyDir(state, i), accountKey, i, options);
        // The only point between directories where the clerk's clicks (the
        // stop button above all) are handled.
        QCoreApplication::processEvents();
        if (state.StopFlag)
            break;
    }
    return accountKey;
}

} // namespace ardcard
