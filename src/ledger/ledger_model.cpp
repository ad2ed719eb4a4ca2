#include "ledger/ledger_model.h"

#include "common/formats.h"
#include "common/text_helpers.h"

#include <algorithm>
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

// A value's text read as a number the way a numeric grid sort reads a cell:
// a number as itself, text that is not a number as 0.
double numericValue(const QVariant& value) {
    bool ok = false;
    const double number = value.toDouble(&ok);
    if (ok)
        return number;
    const double parsed = value.toString().trimmed().toDouble(&ok);
    return ok ? parsed : 0.0;
}

double sortKey(const LedgerRow& row, int column) {
    switch (column) {
    case 0:
        return row.rowNumber;
    case 2:
        return numericValue(row.batchNo);
    case 3:
        return numericValue(row.transId);
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

QString LedgerModel::cellText(int gridRow, int column) const {
    if (column < 0 || column >= kColumns)
        return QString();
    if (gridRow == 0)
        return headerText(column);
    if (gridRow < 1 || gridRow > committed_)
        return QString();
    const LedgerRow& r = rows_[static_cast<size_t>(gridRow - 1)];
    switch (column) {
    case 0:
        return QString::number(r.rowNumber);
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
    case 7:
        return r.description;
    case 8:
        return FormatMoney(r.amount);
    case 9:
        return FormatMoney(r.foreignAmount);
    case 10:
        return r.currencyCode;
    case 11:
        return FormatMoney(r.balance);
    case 12:
        return r.costCode;
    case 13:
        return QString::number(r.fullMatch);
    case 14:
    case 15:
        return QStringLiteral("0");
    default:
        return QString::number(r.currencyId);
    }
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
    if (more > 0)
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
    case Qt::DisplayRole:
        return cellText(index.row() + 1, index.column());
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
