#pragma once

#include "ledger/stored_value.h"

#include <QDate>
#include <QString>

namespace ardcard {

// Where a grid row came from: the 1-based position of its company in the
// company-directory list, and the transaction's counter account.
struct RowDetail {
    int CompIndex = 0;
    QString CounterKey;
    QString CounterName; // empty unless counter names are read
};

// One journal line as the grid keeps it: typed values; the cell texts are
// formatted from them on demand (LedgerModel::cellText), so a million rows do
// not cost seventeen strings each. Batch and transaction numbers stay the
// database's own values (a number is held without a heap string) and show as
// that value's text.
struct LedgerRow {
    StoredValue batchNo;  // col 2, the value's text
    StoredValue transId;  // col 3, the value's text
    QString description;  // col 7, " " for Null
    QString currencyCode; // col 10, empty for Null
    QString costCode;     // col 12, " " for Null
    RowDetail detail;
    double referance = 0;     // col 5, plain number (Null read as 0)
    double ref2 = 0;          // col 6, plain number
    double amount = 0;        // col 8, signed shekels, ##,##0.00
    double foreignAmount = 0; // col 9, ##,##0.00
    double balance = 0;       // col 11, running balance, ##,##0.00
    QDate valueDate;          // col 1, dd/mm/yy
    QDate dueDate;            // col 4, dd/mm/yy
    int rowNumber = 0;        // col 0
    int fullMatch = 0;        // col 13
    // cols 14 and 15 are always "0"
    int currencyId = 0; // col 16
};

} // namespace ardcard
