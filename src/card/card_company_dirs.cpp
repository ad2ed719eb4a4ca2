// The company-directory text: set by a container, typed by the clerk, or
// taken over from the connection dialog.

#include "card/card.h"

#include "card/card_screen.h"
#include "common/failure.h"
#include "common/module_state.h"
#include "common/text_helpers.h"
#include "connection/company_details.h"
#include "connection/conn_dialog.h"

#include <QLineEdit>

namespace ardcard {

bool Card::GetCompDetails7(const QString& pCompPath) {
    ReadCompanyDetails(pCompPath);
    return false;
}

void Card::readFirstCompanyDetails() {
    // A list that never held a directory names no company to read.
    const ModuleState& state = moduleState();
    if (state.CompanyDirList.size() > 1)
        GetCompDetails7(state.CompanyDirList.at(1));
}

void Card::takeCompanyDirs(const QString& text, bool passOverFailures) {
    ModuleState& state = moduleState();
    const auto run = [&](const auto& body) {
        if (!passOverFailures) {
            body();
            return;
        }
        try {
            body();
        } catch (const Failure&) {
            // SetParams goes on at the next step.
        }
    };
    run([&] {
        state.CompanyDirText = text;
        ui_->txtCompPath->setText(state.CompanyDirText);
    });
    run([&] {
        state.CompanyDirCount = SplitCompanyDirs(state.CompanyDirText, state.CompanyDirList);
    });
    run([&] { readFirstCompanyDetails(); });
}

void Card::txtCompPath_Change() {
    moduleState().CompanyDirText = ui_->txtCompPath->text();
    EnableButtons(false);
}

void Card::txtCompPath_LostFocus() {
    ModuleState& state = moduleState();
    state.CompanyDirCount = SplitCompanyDirs(state.CompanyDirText, state.CompanyDirList);
}

void Card::Image1_Click() {
    try {
        if (!connDialog_)
            connDialog_ = new frmAConn(this);
        connDialog_->exec();
        ModuleState& state = moduleState();
        state.CompanyDirText = state.conn.ConnDataBase;
        const bool same = ui_->txtCompPath->text() == state.CompanyDirText;
        ui_->txtCompPath->setText(state.CompanyDirText);
        if (same) // setText reports no change; the handler runs all the same
            txtCompPath_Change();
    } catch (const Failure&) {
        // The card stays as it was.
    }
}

} // namespace ardcard
