#include "ledger/ledger_model.h"

#include "common/formats.h"
#include "common/text_helpers.h"

#include <algorithm>
#include <cstring>
#include <numeric>

namespace ardcard {

namespace {

// The header words with the trailing spaces that set each column's opening
// width; the 17th column (currency id) has no header.
QString headerWord(int column) {
    switch (column) {
    case 0:
        return QStringLiteral("שורה");
    case 1:
        return QStringLiteral("תאריך") + QString(10, u' ');
    case 2:
        return QStringLiteral("מנה") + QString(5, u' ');
    case 3:
        return QStringLiteral("תנועה");
    case 4:
        return QStringLiteral("תאריך ערך");
    case 5:
        return QStringLiteral("אסמכתא 1");
    case 6:
        return QStringLiteral("אסמכתא 2");
    case 7:
        return QStringLiteral("פרטים") + QString(30, u' ');
    case 8:
        return QStringLiteral("סכום") + QString(20, u' ');
    case 9:
        return QStringLiteral("סכום מטח") + QString(15, u' ');
    case 10:
        return QStringLiteral("מט");
    case 11:
        return QStringLiteral("יתרה שח") + QString(20, u' ');
    case 12:
        return QStringLiteral("תמחיר");
    case 13:
        return QStringLiteral("התאמה");
    case 14:
        return QStringLiteral("התאמה $");
    case 15:
        return QStringLiteral("הת בנק");
    default:
        return QString();
    }
}

const RowDetail& emptyDetail() {
    static const RowDetail detail;
    return detail;
}

double sortKey(const LedgerRow& row, int column) {
    switch (column) {
    case 0:
        return row.rowNumber;
    case 2:
        return row.batchNo.sortNumber();
    case 3:
        return row.transId.sortNumber();
    case 5:
        return row.referance;
    case 6:
        return row.ref2;
    default:
        return 0.0;
    }
}

} // namespace

LedgerModel::LedgerModel(QObject* parent) : QAbstractTableModel(parent) {}

QString LedgerModel::headerText(int column) {
    return headerWord(column);
}

bool LedgerModel::isSortable(int column) {
    return column == 0 || column == 2 || column == 3 || column == 5 || column == 6;
}

namespace {

// The text a row holds as it is shown (columns 7, 10 and 12); null for the
// columns formatted from a typed value.
const QString* heldText(const LedgerRow& r, int column) {
    switch (column) {
    case 7:
        return &r.description;
    case 10:
        return &r.currencyCode;
    case 12:
        return &r.costCode;
    default:
        return nullptr;
    }
}

// The ASCII text of a formatted column into `out`, or 0 when the value
// needs the general conversion (generalText). Never 0 for a real text: every
// formatted cell has at least one character.
size_t formattedTo(char* out, const LedgerRow& r, int column, bool thousands) {
    switch (column) {
    case 0:
        return FormatIntegerTo(out, r.rowNumber);
    case 1:
        return FormatShortDateTo(out, r.valueDate);
    case 2:
        return FormatStoredIntegerTo(out, r.batchNo);
    case 3:
        return FormatStoredIntegerTo(out, r.transId);
    case 4:
        return FormatShortDateTo(out, r.dueDate);
    case 5:
        return PlainWholeTo(out, r.referance);
    case 6:
        return PlainWholeTo(out, r.ref2);
    case 8:
        return FormatMoneyTo(out, r.amount, thousands);
    case 9:
        return FormatMoneyTo(out, r.foreignAmount, thousands);
    case 11:
        return FormatMoneyTo(out, r.balance, thousands);
    case 13:
        return FormatIntegerTo(out, r.fullMatch);
    case 14:
    case 15:
        *out = '0';
        return 1;
    default:
        return FormatIntegerTo(out, r.currencyId);
    }
}

// The general text of the columns formattedTo() leaves: odd dates, numbers
// with a fraction, batch numbers that are not integers.
QString generalText(const LedgerRow& r, int column) {
    switch (column) {
    case 1:
        return FormatShortDate(r.valueDate);
    case 2:
        return r.batchNo.toString();
    case 3:
        return r.transId.toString();
    case 4:
        return FormatShortDate(r.dueDate);
    case 5:
        return PlainNumber(r.referance);
    case 6:
        return PlainNumber(r.ref2);
    default:
        return QString();
    }
}

} // namespace

namespace {
// The view of one cell of a data row: a held text, ASCII formatted into
// `ascii`, or the general text put into `text`.
LedgerModel::CellView viewOf(const LedgerRow& r, int column, bool thousands, char* ascii,
                             QString& text) {
    LedgerModel::CellView view;
    if (const QString* held = heldText(r, column)) {
        view.text = *held;
    } else if (const size_t len = formattedTo(ascii, r, column, thousands)) {
        view.isAscii = true;
        view.ascii = std::string_view(ascii, len);
    } else {
        text = generalText(r, column);
        view.text = text;
    }
    return view;
}
} // namespace

LedgerModel::CellView LedgerModel::cellView(int gridRow, int column, CellScratch& scratch) const {
    if (column < 0 || column >= kColumns)
        return {};
    if (gridRow == 0) {
        scratch.text = headerText(column);
        CellView view;
        view.text = scratch.text;
        return view;
    }
    if (gridRow < 1 || gridRow > committed_)
        return {};
    return viewOf(rows_[static_cast<size_t>(gridRow - 1)], column, true, scratch.ascii,
                  scratch.text);
}

void LedgerModel::readRow(int gridRow, int lastColumn, MoneyText money, RowCells& cells) const {
    lastColumn = std::min(lastColumn, kColumns - 1);
    if (gridRow < 1 || gridRow > committed_) {
        for (int c = 0; c <= lastColumn; ++c)
            cells.cell[c] = CellView();
        return;
    }
    const LedgerRow& r = rows_[static_cast<size_t>(gridRow - 1)];
    for (int c = 0; c <= lastColumn; ++c)
        cells.cell[c] = viewOf(r, c, money == MoneyText::Grouped, cells.ascii + c * kNumberTextMax,
                               cells.text[c]);
}

QString LedgerModel::cellText(int gridRow, int column) const {
    // Held texts are shared, not copied.
    if (gridRow >= 1 && gridRow <= committed_ && column >= 0 && column < kColumns) {
        if (const QString* held = heldText(rows_[static_cast<size_t>(gridRow - 1)], column))
            return *held;
    }
    CellScratch scratch; // its text stays null when there is no cell
    const CellView view = cellView(gridRow, column, scratch);
    if (view.isAscii)
        return QString::fromLatin1(view.ascii.data(), static_cast<qsizetype>(view.ascii.size()));
    return scratch.text; // the header, a general text, or null for no cell
}

const RowDetail& LedgerModel::rowDetail(int gridRow) const {
    if (gridRow < 1 || gridRow > committed_)
        return emptyDetail();
    return rows_[static_cast<size_t>(gridRow - 1)].detail;
}

const LedgerRow& LedgerModel::row(int gridRow) const {
    Q_ASSERT(gridRow >= 1 && gridRow <= committed_);
    return rows_[static_cast<size_t>(gridRow - 1)];
}

void LedgerModel::clear() {
    beginResetModel();
    // Give the storage back: a fetch of a million lines should not keep its
    // memory after the grid is laid out afresh.
    std::vector<LedgerRow>().swap(rows_);
    committed_ = 0;
    endResetModel();
}

void LedgerModel::append(LedgerRow row) {
    stage(std::move(row));
    commitStaged();
}

void LedgerModel::reserve(qsizetype more) {
    if (more <= 0)
        return;
    rows_.reserve(rows_.size() + static_cast<size_t>(more));
}

void LedgerModel::stage(LedgerRow&& row) {
    rows_.push_back(std::move(row));
}

void LedgerModel::commitStaged() {
    const int staged = static_cast<int>(stagedCount());
    if (staged <= 0)
        return;
    // The new rows go directly above the blank row, which is model row committed_.
    beginInsertRows(QModelIndex(), committed_, committed_ + staged - 1);
    committed_ += staged;
    endInsertRows();
}

bool LedgerModel::sortNumeric(int column) {
    if (!isSortable(column))
        return false;
    const auto n = static_cast<size_t>(committed_);
    std::vector<double> keys(n);
    for (size_t i = 0; i < n; ++i)
        keys[i] = sortKey(rows_[i], column);
    // order[newPosition] = oldPosition; stable, so equal numbers keep the
    // order in which they were read.
    std::vector<int> order(n);
    std::iota(order.begin(), order.end(), 0);
    std::stable_sort(order.begin(), order.end(), [&keys](int a, int b) {
        return keys[static_cast<size_t>(a)] < keys[static_cast<size_t>(b)];
    });

    Q_EMIT layoutAboutToBeChanged({}, QAbstractItemModel::VerticalSortHint);
    std::vector<LedgerRow> sorted;
    sorted.reserve(rows_.size());
    for (int old : order)
        sorted.push_back(std::move(rows_[static_cast<size_t>(old)]));
    for (size_t i = n; i < rows_.size(); ++i) // staged rows keep their place after the grid
        sorted.push_back(std::move(rows_[i]));
    rows_.swap(sorted);

    std::vector<int> newPosition(n);
    for (size_t i = 0; i < n; ++i)
        newPosition[static_cast<size_t>(order[i])] = static_cast<int>(i);
    const QModelIndexList before = persistentIndexList();
    QModelIndexList after;
    after.reserve(before.size());
    for (const QModelIndex& index : before) {
        const int r = index.row();
        const int moved = r < committed_ ? newPosition[static_cast<size_t>(r)] : r;
        after.append(this->index(moved, index.column()));
    }
    changePersistentIndexList(before, after);
    Q_EMIT layoutChanged({}, QAbstractItemModel::VerticalSortHint);
    return true;
}

int LedgerModel::rowCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : committed_ + 1;
}

int LedgerModel::columnCount(const QModelIndex& parent) const {
    return parent.isValid() ? 0 : kColumns;
}

QVariant LedgerModel::data(const QModelIndex& index, int role) const {
    if (!checkIndex(index, CheckIndexOption::IndexIsValid | CheckIndexOption::ParentIsInvalid))
        return QVariant();
    switch (role) {
    case Qt::DisplayRole: {
        // The view lays text out right to left, which would draw "-1,234.50"
        // as "1,234.50-"; a left-to-right mark keeps a signed amount reading
        // as written. Only what the view draws changes, not the cell's text.
        QString text = cellText(index.row() + 1, index.column());
        if (text.startsWith(u'-'))
            text.prepend(QChar(0x200E));
        return text;
    }
    case Qt::TextAlignmentRole:
        return QVariant::fromValue(Qt::Alignment(Qt::AlignLeft | Qt::AlignVCenter));
    default:
        return QVariant();
    }
}

QVariant LedgerModel::headerData(int section, Qt::Orientation orientation, int role) const {
    if (orientation == Qt::Horizontal && section >= 0 && section < kColumns) {
        if (role == Qt::DisplayRole)
            return headerText(section);
        if (role == Qt::TextAlignmentRole)
            return QVariant::fromValue(Qt::Alignment(Qt::AlignLeft | Qt::AlignVCenter));
        return QVariant();
    }
    return QAbstractTableModel::headerData(section, orientation, role);
}

} // namespace ardcard
