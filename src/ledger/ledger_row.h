#pragma once

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
// formatted from them on demand (LedgerModel::cellText).
struct LedgerRow {
    qint64 rowNumber = 0;     // col 0
    QDate valueDate;          // col 1, dd/mm/yy
    QString batchNo;          // col 2, the value's text
    QString transId;          // col 3, the value's text
    QDate dueDate;            // col 4, dd/mm/yy
    double referance = 0;     // col 5, plain number (Null read as 0)
    double ref2 = 0;          // col 6, plain number
    QString description;      // col 7, " " for Null
    double amount = 0;        // col 8, signed shekels, ##,##0.00
    double foreignAmount = 0; // col 9, ##,##0.00
    QString currencyCode;     // col 10, empty for Null
    double balance = 0;       // col 11, running balance, ##,##0.00
    QString costCode;         // col 12, " " for Null
    int fullMatch = 0;        // col 13
    // cols 14 and 15 are always "0"
    int currencyId = 0; // col 16
    RowDetail detail;
};

} // namespace ardcard
