#include "ledger/fetch_command.h"

#include "common/failure.h"
#include "common/module_state.h"
#include "common/text_helpers.h"
#include "ledger/ledger_model.h"

#include <QCoreApplication>
#include <algorithm>
#include <cmath>

namespace ardcard {

namespace {

// fetched / count of the frame's width, halves to even; never outside the
// frame even when the count query announced fewer lines than the main query
// gave.
int fillWidth(qint64 fetched, double count, int frameWidth) {
    const double width = std::nearbyint(static_cast<double>(fetched) / count * frameWidth);
    return static_cast<int>(std::clamp(width, 0.0, static_cast<double>(std::max(frameWidth, 0))));
}

// Appends a read's rows to the grid and keeps the thread's totals in step
// with them, moving the progress bar as the lines come.
class LedgerSink final : public JournalSink {
public:
    LedgerSink(LedgerModel& ledger, ProgressSink& progress, bool onlyGraph)
        : ledger_(ledger), progress_(progress), onlyGraph_(onlyGraph) {}

    double countedLines() const { return count_; }

    void counted(double lines) override {
        count_ = lines;
        if (lines == 0.0)
            return;
        if (!onlyGraph_)
            ledger_.reserve(static_cast<qsizetype>(lines));
        progress_.setFillWidth(0);
        frameWidth_ = progress_.frameWidth();
    }
    void progressed(qint64 fetched) override {
        progress_.setFillWidth(fillWidth(fetched, count_, frameWidth_));
    }
    void delivered(std::vector<LedgerRow>&& rows, const JournalTotals& totals) override {
        for (LedgerRow& row : rows)
            ledger_.stage(std::move(row));
        ledger_.commitStaged();
        ModuleState& state = moduleState();
        state.CurrencyCodes = totals.currencyCodes;
        state.CurrencyTotals = totals.currencyTotals;
        state.periods = totals.periods;
    }

private:
    LedgerModel& ledger_;
    ProgressSink& progress_;
    const bool onlyGraph_;
    double count_ = 0.0;
    int frameWidth_ = 0;
};

bool accountHidden(const ModuleState& state) {
    const QString& hidden = state.company.HiddenAccountsFilter;
    return !hidden.isEmpty() &&
           hidden.compare(state.CurrentAccountFilter, Qt::CaseInsensitive) == 0;
}

} // namespace

int ReadTransactions7(const QString& CompPath, const QString& pAccountKey, int pCompID,
                      const JournalOptions& options, LedgerModel& ledger, ProgressSink& progress,
                      QString* failure) {
    if (failure)
        failure->clear();
    const ModuleState& state = moduleState();
    if (accountHidden(state))
        return 0;
    JournalRequest request{state.conn, CompPath, pAccountKey, pCompID, options, {}};
    request.totals.currencyCodes = state.CurrencyCodes;
    request.totals.currencyTotals = state.CurrencyTotals;
    request.totals.periods = state.periods;
    progress.setFillWidth(0);
    LedgerSink sink(ledger, progress, options.onlyGraph);
    try {
        ReadJournal(request, sink);
    } catch (const Failure& error) {
        if (failure)
            *failure = error.description();
        return 0;
    }
    if (sink.countedLines() > 0.0)
        progress.setFillWidth(0);
    return -1;
}

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
    QString accountKey = StripQuotes(pAccountKey);
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
