// Placeholders for the members that the ledger grid and fetch, the outputs
// and the information page fill in; each part leaves this file when its own
// file takes over.

#include "card/card.h"

#include "ledger/ledger_model.h"

namespace ardcard {

// Ledger grid and fetch.
void Card::InitDocLines() {
    ledger_->clear();
    EnableButtons(false);
}
void Card::ShowTransButt_Click() {}
QString Card::ReadAllTransactions(const QString& /*CompPath*/, const QString& pAccountKey) {
    return pAccountKey;
}
int Card::ReadTransactions7(const QString& /*CompPath*/, const QString& /*pAccountKey*/,
                            int /*pCompID*/, bool /*pOnlyOpenTrans*/, int /*pGraphDate*/,
                            bool /*pIncNegdiName*/) {
    return 0;
}
void Card::CmdStop_Click() {}
void Card::DocLines_Click(int /*gridRow*/, int /*column*/) {}

// Outputs.
void Card::CreateHTML(const QString& /*pFileName*/) {}
void Card::CreateCSV(const QString& /*pFileName*/) {}
void Card::CreateCSV_HTML(const QString& /*pFileName*/, const QString& /*CSVFile*/) {}
void Card::CreateHTMLGraph(const QString& /*pFileName*/, int /*pGraphType*/) {}
void Card::WriteHeader(TextFileWriter& /*file*/, const QString& /*pTitle*/,
                       const QString& /*pContent*/) {}
void Card::PrintButt_Click() {}
void Card::ExcelButt_Click() {}
void Card::CmdGraph_Click() {}

// Information page.
void Card::imgAccKey_DblClick() {}

} // namespace ardcard
