// Placeholders for the members that the ledger grid and fetch, the outputs
// and the information page fill in; each part leaves this file when its own
// file takes over.

#include "card/card.h"

namespace ardcard {

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
