#pragma once

#include "ledger/ledger_row.h"

#include <QAbstractTableModel>
#include <vector>

namespace ardcard {

// The ledger grid's rows. The grid as the rest of the system sees it (the
// `DocLines` numbering): row 0 is the header row, data rows are 1 to
// gridRowCount() - 2, and one blank row always stays last; 17 columns.
//
// As a Qt model the header row is the horizontal header, so model row i is
// grid row i + 1 and the blank row is the model's last row.
class LedgerModel : public QAbstractTableModel {
    Q_OBJECT
public:
    static constexpr int kColumns = 17;

    explicit LedgerModel(QObject* parent = nullptr);

    // Grid view (DocLines numbering).
    int gridRowCount() const { return static_cast<int>(rows_.size()) + 2; }
    int dataRowCount() const { return static_cast<int>(rows_.size()); }
    // Text of a cell as the grid shows it; row 0 gives the header texts.
    QString cellText(int gridRow, int column) const;
    // The row's details; grid row 0 and the blank row give an empty detail.
    const RowDetail& rowDetail(int gridRow) const;
    const LedgerRow& row(int gridRow) const; // grid rows 1..gridRowCount()-2

    // Header text of a column, trailing spaces included; column 16 is empty.
    static QString headerText(int column);

    // Lays the grid out afresh: header and the blank row only.
    void clear();
    // Inserts a row directly above the blank row.
    void append(LedgerRow row);
    // Sorts the data rows numerically ascending by column 0, 2, 3, 5 or 6,
    // each row keeping its details, the blank row staying last; any other
    // column does nothing. Returns whether it sorted.
    bool sortNumeric(int column);

    // QAbstractTableModel
    int rowCount(const QModelIndex& parent = {}) const override;
    int columnCount(const QModelIndex& parent = {}) const override;
    QVariant data(const QModelIndex& index, int role = Qt::DisplayRole) const override;
    QVariant headerData(int section, Qt::Orientation orientation,
                        int role = Qt::DisplayRole) const override;

private:
    std::vector<LedgerRow> rows_;
};

} // namespace ardcard
