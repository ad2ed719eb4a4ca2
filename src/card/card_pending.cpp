// Placeholders for the members that the ledger grid and fetch and the
// information page fill in; each part leaves this file when its own
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

// Information page.
void Card::imgAccKey_DblClick() {}

} // namespace ardcard
