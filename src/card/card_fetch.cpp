// The card's ledger members: laying the grid out, the fetch and stop
// buttons, the per-company read with its progress bar, and the header sort.
// The reading itself lives in src/ledger/; here the card supplies its check
// boxes and frames and shows the failures.

#include "card/card.h"
#include "card/card_screen.h"

#include "common/failure.h"
#include "common/module_state.h"
#include "host/seams.h"
#include "ledger/fetch_command.h"
#include "ledger/journal_reader.h"
#include "ledger/ledger_model.h"

#include <QCheckBox>
#include <QComboBox>
#include <QCoreApplication>
#include <QElapsedTimer>
#include <QFrame>
#include <QLineEdit>

namespace ardcard {

namespace {

const QString& failureTitle() {
    static const QString title = QStringLiteral("תקלה");
    return title;
}

// The bar of two frames. The read holds the thread, so a new width is
// painted at once rather than at the next turn of the event loop; painting
// at most every few hundredths of a second keeps the bar moving smoothly
// without the painting costing the read time.
class FrameProgress final : public ProgressSink {
public:
    FrameProgress(QFrame* frame, QFrame* fill) : frame_(frame), fill_(fill) { sincePaint_.start(); }
    int frameWidth() const override { return frame_->width(); }
    void setFillWidth(int width) override {
        if (width == fill_->width())
            return;
        fill_->resize(width, fill_->height());
        if (width == 0 || sincePaint_.elapsed() >= kPaintIntervalMs) {
            frame_->repaint();
            sincePaint_.restart();
        }
    }

private:
    static constexpr qint64 kPaintIntervalMs = 40;
    QFrame* frame_;
    QFrame* fill_;
    QElapsedTimer sincePaint_;
};

} // namespace

void Card::InitDocLines() {
    InitLedgerData(*ledger_);
    EnableButtons(false);
}

void Card::ShowTransButt_Click() {
    if (ui_->txtAccountKey->text().isEmpty())
        return;
    ModuleState& state = moduleState();
    state.StopFlag = false;
    InitDocLines();
    // Lets the cleared grid show, and a stop click already queued take effect.
    QCoreApplication::processEvents();
    if (state.StopFlag)
        return;
    ReadAllTransactions(state.CompanyDirText, ui_->txtAccountKey->text().trimmed());
    EnableButtons(true);
}

QString Card::ReadAllTransactions(const QString& CompPath, const QString& pAccountKey) {
    FetchSources sources;
    sources.includeCounterNames = [this] { return ui_->chkNegdiName->isChecked(); };
    sources.directoryOptions = [this] {
        JournalOptions options;
        options.onlyOpen = ui_->ChkOnlyOpenTrans->isChecked();
        options.graphDate = ui_->CmbGraphDate->currentIndex();
        return options;
    };
    sources.readDirectory = [this](const QString& compPath, const QString& accountKey, int compId,
                                   const JournalOptions& options) {
        return ReadTransactions7(compPath, accountKey, compId, options.onlyOpen, options.graphDate,
                                 options.incNegdiName);
    };
    return ardcard::ReadAllTransactions(CompPath, pAccountKey, sources);
}

int Card::ReadTransactions7(const QString& CompPath, const QString& pAccountKey, int pCompID,
                            bool pOnlyOpenTrans, int pGraphDate, bool pIncNegdiName) {
    JournalOptions options;
    options.onlyOpen = pOnlyOpenTrans;
    options.graphDate = pGraphDate;
    options.incNegdiName = pIncNegdiName;
    options.onlyGraph = ui_->ChkOnlyGraph->isChecked();
    FrameProgress progress(ui_->ProgressFrame, ui_->ProgressFill);
    QString failure;
    const int result = ardcard::ReadTransactions7(CompPath, pAccountKey, pCompID, options, *ledger_,
                                                  progress, &failure);
    if (!failure.isEmpty())
        host::messageBox().show(failureTitle(), failure, host::MessageIcon::Information);
    return result;
}

void Card::CmdStop_Click() {
    moduleState().StopFlag = true;
    EnableButtons(false);
}

void Card::DocLines_Click(int gridRow, int column) {
    if (gridRow != 0 || !LedgerModel::isSortable(column))
        return;
    try {
        ledger_->sortNumeric(column);
    } catch (const Failure& failure) {
        host::messageBox().show(failureTitle(), failure.description(), host::MessageIcon::Critical);
    } catch (const std::exception& error) {
        host::messageBox().show(failureTitle(), QString::fromLocal8Bit(error.what()),
                                host::MessageIcon::Critical);
    }
}

} // namespace ardcard
