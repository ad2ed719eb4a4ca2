// The card's three outputs: the printable statement, the CSV export with
// its page, and the graph page. The writers live in src/reports/; the card
// hands them its screen values and its ledger and shows the result.

#include "card/card.h"

#include "card/card_screen.h"
#include "common/module_state.h"
#include "ledger/ledger_model.h"
#include "reports/csv_writer.h"
#include "reports/graph_writer.h"
#include "reports/output_command.h"
#include "reports/page_markup.h"
#include "reports/report_screen.h"
#include "reports/statement_writer.h"

#include <QCheckBox>
#include <QComboBox>
#include <QLineEdit>

namespace ardcard {

namespace {

reports::ReportScreen screenValues(const CardScreen& ui) {
    reports::ReportScreen s;
    s.accountKey = ui.txtAccountKey->text();
    s.accountName = ui.txtAccountName->text();
    s.address = ui.txtAddress->text();
    s.telephone = ui.txtTelephone->text();
    s.details = ui.txtDetails->text();
    s.balance = ui.txtBalance->text();
    s.shipBalance = ui.txtShipBalance->text();
    s.oblig = ui.txtOblig->text();
    s.showHeadDetails = ui.chkShowHeadDetails->isChecked();
    s.negdiName = ui.chkNegdiName->isChecked();
    s.graphKind = ui.CmbGraphType->currentIndex();
    return s;
}

} // namespace

void Card::PrintButt_Click() {
    const QString path = reports::OutputPath(reports::kStatementFile);
    reports::RunOutputCommand([&] { CreateHTML(path); }, path);
}

void Card::CreateHTML(const QString& pFileName) {
    // The heading names the company the directories stand for now.
    GetCompDetails7(moduleState().CompanyDirText);
    reports::WriteStatement(pFileName, *ledger_, moduleState(), screenValues(*ui_));
}

void Card::WriteHeader(TextFileWriter& file, const QString& pTitle, const QString& pContent) {
    reports::WriteStatementHeading(file, pTitle, pContent);
}

void Card::ExcelButt_Click() {
    const QString csvPath = reports::OutputPath(reports::kCsvFile);
    const QString pagePath = reports::OutputPath(reports::kCsvPageFile);
    reports::RunOutputCommand(
        [&] {
            CreateCSV(csvPath);
            CreateCSV_HTML(pagePath, csvPath);
        },
        pagePath);
}

void Card::CreateCSV(const QString& pFileName) {
    reports::WriteCsv(pFileName, *ledger_, moduleState(), ui_->chkNegdiName->isChecked());
}

void Card::CreateCSV_HTML(const QString& pFileName, const QString& CSVFile) {
    reports::WriteCsvPage(pFileName, CSVFile);
}

void Card::CmdGraph_Click() {
    const int kind = ui_->CmbGraphType->currentIndex();
    // An empty graph opens no window: an earlier page on the same path would
    // pass for the current one.
    if (!reports::GraphHasBars(moduleState().periods, kind)) {
        reports::ReportNothingToDraw();
        return;
    }
    const QString path = reports::OutputPath(reports::kGraphFile);
    reports::RunOutputCommand([&] { CreateHTMLGraph(path, kind); }, path);
}

void Card::CreateHTMLGraph(const QString& pFileName, int pGraphType) {
    if (!reports::GraphHasBars(moduleState().periods, pGraphType))
        return;
    GetCompDetails7(moduleState().CompanyDirText);
    const ModuleState& state = moduleState();
    reports::WriteGraph(pFileName, state.periods, pGraphType, state.company.ShortName,
                        ui_->txtAccountKey->text(), ui_->txtAccountName->text());
}

} // namespace ardcard
