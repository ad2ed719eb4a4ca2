#pragma once

#include "common/formats.h"
#include "ledger/ledger_row.h"

#include <QAbstractTableModel>
#include <string_view>
#include <vector>

namespace ardcard {

// The ledger grid's rows. The grid as the rest of the system sees it (the
// `DocLines` numbering): row 0 is the header row, data rows are 1 to
// gridRowCount() - 2, and one blank row always stays last; 17 columns.
//
// As a Qt model the header row is the horizontal header, so model row i is
// grid row i + 1 and the blank row is the model's last row.
//
// Rows are kept typed and formatted only when a cell is asked for. A long
// read adds rows in two steps: stage() keeps a row out of sight of views and
// of the grid numbering, commitStaged() shows every staged row with one
// insertion, so a million lines do not cost a million view updates.
class LedgerModel : public QAbstractTableModel {
    Q_OBJECT
public:
    static constexpr int kColumns = 17;

    explicit LedgerModel(QObject* parent = nullptr);

    // Grid view (DocLines numbering).
    int gridRowCount() const { return committed_ + 2; }
    int dataRowCount() const { return committed_; }
    // Text of a cell as the grid shows it; row 0 gives the header texts, the
    // blank row and anything outside the grid an empty text.
    QString cellText(int gridRow, int column) const;

    // The same text for writers that read every cell of a large ledger,
    // without a string per cell: a view of the text the row holds, or a
    // number or date formatted as ASCII into the caller's scratch. Values
    // that need Qt's own conversion land in scratch.text. The view lives
    // until the scratch is reused or the row changes.
    struct CellScratch {
        char ascii[kNumberTextMax];
        QString text;
    };
    struct CellView {
        bool isAscii = false;
        // When isAscii: only digits and "-,./" (numbers and dates), never a
        // character a page must escape.
        std::string_view ascii;
        QStringView text; // otherwise
    };
    CellView cellView(int gridRow, int column, CellScratch& scratch) const;

    // Cells 0 to lastColumn of one data row at once, for writers that go
    // through every row: one lookup of the row instead of one per cell, the
    // same views cellView gives. With MoneyText::Plain the amounts (columns
    // 8, 9 and 11) come without their thousands commas, as the CSV file
    // writes them. The views live until `cells` is reused or the row changes.
    enum class MoneyText { Grouped, Plain };
    struct RowCells {
        CellView cell[kColumns];
        char ascii[kColumns * kNumberTextMax];
        QString text[kColumns]; // the rare general texts
    };
    void readRow(int gridRow, int lastColumn, MoneyText money, RowCells& cells) const;
    // The row's details; grid row 0 and the blank row give an empty detail.
    const RowDetail& rowDetail(int gridRow) const;
    const LedgerRow& row(int gridRow) const; // grid rows 1..gridRowCount()-2

    // Header text of a column, trailing spaces included; column 16 is empty.
    static QString headerText(int column);
    // Whether a header click on this column sorts (0, 2, 3, 5 and 6).
    static bool isSortable(int column);

    // Lays the grid out afresh: header and the blank row only.
    void clear();
    // Inserts a row directly above the blank row.
    void append(LedgerRow row);
    // Room for `more` rows beyond those held and staged, so a read that knows
    // its count grows the storage once.
    void reserve(qsizetype more);
    // Keeps a row for the next commitStaged(); it is not yet part of the grid.
    void stage(LedgerRow&& row);
    qsizetype stagedCount() const { return static_cast<qsizetype>(rows_.size()) - committed_; }
    // Inserts the staged rows above the blank row, in the order staged.
    void commitStaged();
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
    // rows_[0 .. committed_) are in the grid; the rest are staged.
    std::vector<LedgerRow> rows_;
    int committed_ = 0;
};

} // namespace ardcard
