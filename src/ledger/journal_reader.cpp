#include "ledger/journal_reader.h"

#include "common/failure.h"
#include "common/module_state.h"
#include "common/text_helpers.h"
#include "connection/conn_string.h"
#include "connection/database.h"
#include "ledger/journal_sql.h"
#include "ledger/ledger_model.h"

#include <QSet>
#include <algorithm>
#include <cmath>
#include <limits>

namespace ardcard {

namespace {

// Rows reach the grid (and an attached view) in batches: one insertion per
// batch instead of one per journal line. A long read uses fewer, larger
// batches, since each insertion costs an attached view work in proportion to
// the rows it already shows.
constexpr qsizetype kMinCommitBatch = 4096;
constexpr qsizetype kCommitsPerRead = 32;

// Short texts that repeat from line to line (currency and costing codes,
// counter accounts) share one string, so a long ledger does not
// keep a copy per row. The pool stops growing at `limit` distinct values.
class StringPool {
public:
    explicit StringPool(qsizetype limit) : limit_(limit) {}
    QString intern(const QString& text) {
        // Consecutive lines mostly repeat the code of the line before.
        if (text == last_)
            return last_;
        const auto it = pool_.constFind(text);
        if (it != pool_.cend()) {
            last_ = *it;
            return last_;
        }
        if (pool_.size() < limit_)
            pool_.insert(text);
        last_ = text;
        return text;
    }

private:
    QSet<QString> pool_;
    QString last_;
    qsizetype limit_;
};

// Column positions of the main query, resolved once per read.
struct Columns {
    int transId, valueDate, dueDate, batchNo, referance, ref2, description, costCode;
    int currencyCode, transDebId, transCredId, accountKey, suF, suFDlr, debitCredit;
    int fullMatch, currencyId, cName = -1, dName = -1;
};

int resolve(const Recordset& rs, const QString& name) {
    const int index = rs.indexOf(name);
    if (index < 0)
        throw Failure(QStringLiteral("השדה %1 אינו קיים בתוצאת השאילתה").arg(name));
    return index;
}

Columns resolveColumns(const Recordset& rs, bool incNegdiName) {
    Columns c{};
    c.transId = resolve(rs, QStringLiteral("TransID"));
    c.valueDate = resolve(rs, QStringLiteral("ValueDate"));
    c.dueDate = resolve(rs, QStringLiteral("DueDate"));
    c.batchNo = resolve(rs, QStringLiteral("BatchNo"));
    c.referance = resolve(rs, QStringLiteral("Referance"));
    c.ref2 = resolve(rs, QStringLiteral("Ref2"));
    c.description = resolve(rs, QStringLiteral("Description"));
    c.costCode = resolve(rs, QStringLiteral("CostCode"));
    c.currencyCode = resolve(rs, QStringLiteral("CurrencyCode"));
    c.transDebId = resolve(rs, QStringLiteral("TransDebID"));
    c.transCredId = resolve(rs, QStringLiteral("TransCredID"));
    c.accountKey = resolve(rs, QStringLiteral("AccountKey"));
    c.suF = resolve(rs, QStringLiteral("SuF"));
    c.suFDlr = resolve(rs, QStringLiteral("SuFDlr"));
    c.debitCredit = resolve(rs, QStringLiteral("DebitCredit"));
    c.fullMatch = resolve(rs, QStringLiteral("FullMatch"));
    c.currencyId = resolve(rs, QStringLiteral("CurrencyID"));
    if (incNegdiName) {
        c.cName = resolve(rs, QStringLiteral("CName"));
        c.dName = resolve(rs, QStringLiteral("DName"));
    }
    return c;
}

// Reads the values of the current row, naming the field and the transaction
// in every failure so that the clerk can find the faulty line.
class LineReader {
public:
    explicit LineReader(const Recordset& rs, int transIdColumn)
        : rs_(rs), transId_(transIdColumn) {}

    QVariant value(int column) const { return rs_.value(column); }

    QVariant required(int column, const char16_t* name) const {
        QVariant v = rs_.value(column);
        if (v.isNull())
            throw Failure(where() + QStringLiteral("חסר ערך בשדה ") + QString::fromUtf16(name));
        return v;
    }
    QDate date(int column, const char16_t* name) const {
        const QDate d = ToDate(required(column, name));
        if (!d.isValid())
            throw Failure(where() + QStringLiteral("השדה ") + QString::fromUtf16(name) +
                          QStringLiteral(" אינו תאריך"));
        return d;
    }
    double number(const QVariant& v, const char16_t* name) const {
        // The drivers hand numbers over as doubles or 64-bit integers; those
        // are read directly, without a general conversion per value.
        if (v.typeId() == QMetaType::Double)
            return *static_cast<const double*>(v.constData());
        if (v.typeId() == QMetaType::LongLong)
            return static_cast<double>(*static_cast<const qlonglong*>(v.constData()));
        bool ok = false;
        const double d = v.toDouble(&ok);
        if (!ok)
            throw Failure(where() + QStringLiteral("השדה ") + QString::fromUtf16(name) +
                          QStringLiteral(" אינו מספר"));
        return d;
    }
    double requiredNumber(int column, const char16_t* name) const {
        return number(required(column, name), name);
    }
    // Null reads as 0; anything else must be a number.
    double numberOrZero(int column, const char16_t* name) const {
        const QVariant v = rs_.value(column);
        return v.isNull() ? 0.0 : number(v, name);
    }
    int integer(int column, const char16_t* name) const {
        const QVariant v = required(column, name);
        if (v.typeId() == QMetaType::LongLong) {
            const qlonglong n = *static_cast<const qlonglong*>(v.constData());
            if (n >= std::numeric_limits<int>::min() && n <= std::numeric_limits<int>::max())
                return static_cast<int>(n);
        }
        bool ok = false;
        const int i = v.toInt(&ok);
        if (!ok)
            throw Failure(where() + QStringLiteral("השדה ") + QString::fromUtf16(name) +
                          QStringLiteral(" אינו מספר שלם"));
        return i;
    }
    // The line's side: 0 debit, 1 credit, -1 for anything else (Null,
    // another number, text).
    int side(int column) const {
        const QVariant v = rs_.value(column);
        if (v.isNull())
            return -1;
        qlonglong n = -1;
        if (v.typeId() == QMetaType::LongLong) {
            n = *static_cast<const qlonglong*>(v.constData());
        } else {
            bool ok = false;
            const int i = v.toInt(&ok);
            n = ok ? i : -1;
        }
        return n == 0 || n == 1 ? static_cast<int>(n) : -1;
    }
    QString where() const {
        const QVariant id = rs_.value(transId_);
        if (id.isNull())
            return QString();
        return QStringLiteral("בתנועה %1: ").arg(id.toString());
    }

private:
    const Recordset& rs_;
    int transId_;
};

bool accountHidden() {
    const ModuleState& state = moduleState();
    const QString& hidden = state.company.HiddenAccountsFilter;
    return !hidden.isEmpty() &&
           hidden.compare(state.CurrentAccountFilter, Qt::CaseInsensitive) == 0;
}

// fetched / count of the frame's width, halves to even; never outside the frame
// even when the count query announced fewer lines than the main query gave.
int fillWidth(qint64 fetched, double recCount, int frameWidth) {
    const double width = std::nearbyint(static_cast<double>(fetched) / recCount * frameWidth);
    return static_cast<int>(std::clamp(width, 0.0, static_cast<double>(std::max(frameWidth, 0))));
}

int read(const QString& compPath, const QString& accountKey, int compId,
         const JournalOptions& options, LedgerModel& ledger, ProgressSink& progress) {
    ModuleState& state = moduleState();
    progress.setFillWidth(0);

    const ConnValues& conn = state.conn;
    Connection connection;
    connection.setTimeout(60);
    connection.open(
        BuildConnString(conn.ConnServer, conn.ConnUID, conn.ConnPWD, compPath, conn.ConnType));
    Recordset rs(connection);

    rs.Open(JournalCountSql(accountKey, options.onlyOpen, options.incNegdiName),
            CursorKind::Dynamic);
    if (rs.Eof())
        return -1;
    const QVariant countValue = rs.value(resolve(rs, QStringLiteral("RecCount")));
    const double recCount = countValue.isNull() ? 0.0 : countValue.toDouble();
    rs.Close();
    if (recCount == 0.0)
        return -1;

    rs.Open(JournalMainSql(accountKey, options.onlyOpen, options.incNegdiName),
            CursorKind::Dynamic);
    progress.setFillWidth(0);
    const Columns c = resolveColumns(rs, options.incNegdiName);
    const LineReader line(rs, c.transId);
    const int frameWidth = progress.frameWidth();
    if (!options.onlyGraph)
        ledger.reserve(static_cast<qsizetype>(recCount));
    const qsizetype commitBatch =
        std::max(kMinCommitBatch, static_cast<qsizetype>(recCount) / kCommitsPerRead);

    StringPool codes(256);
    StringPool counters(4096);
    const QString space = QStringLiteral(" ");
    const QString dash = QStringLiteral("-");

    int rowNumber = 0;
    qint64 fetched = 0;
    double balance = 0.0;
    double sign = 0.0;
    QVariant counterKey;
    QString counterName;
    QDate graphDate;

    while (!rs.Eof()) {
        const QDate valueDate = line.date(c.valueDate, u"ValueDate");
        const QDate dueDate = line.date(c.dueDate, u"DueDate");
        const QString key = line.required(c.accountKey, u"AccountKey").toString();
        if (!key.isEmpty()) {
            ++rowNumber;
            // DebitCredit 0 is a debit line, 1 a credit line; any other value
            // keeps the previous line's sign and counter account.
            const int debitCredit = line.side(c.debitCredit);
            if (debitCredit == 0) {
                counterKey = line.value(c.transDebId);
                sign = 1.0;
                if (options.incNegdiName)
                    counterName = counters.intern(NullToText(line.value(c.dName), dash));
            } else if (debitCredit == 1) {
                counterKey = line.value(c.transCredId);
                sign = -1.0;
                if (options.incNegdiName)
                    counterName = counters.intern(NullToText(line.value(c.cName), dash));
            }
            const double amount = line.requiredNumber(c.suF, u"SuF") * sign;
            const double foreignAmount = line.requiredNumber(c.suFDlr, u"SuFDlr") * sign;
            balance += amount;
            const int fullMatch = line.integer(c.fullMatch, u"FullMatch");

            if (!options.onlyGraph) {
                LedgerRow row;
                row.rowNumber = rowNumber;
                row.valueDate = valueDate;
                row.batchNo = line.required(c.batchNo, u"BatchNo");
                row.transId = line.required(c.transId, u"TransID");
                row.dueDate = dueDate;
                row.referance = line.numberOrZero(c.referance, u"Referance");
                row.ref2 = line.numberOrZero(c.ref2, u"Ref2");
                row.description = NullToText(line.value(c.description), space);
                row.amount = amount;
                row.foreignAmount = foreignAmount;
                const QVariant code = line.value(c.currencyCode);
                row.currencyCode = code.isNull() ? QString() : codes.intern(code.toString());
                row.balance = balance;
                row.costCode = codes.intern(NullToText(line.value(c.costCode), space));
                row.fullMatch = fullMatch;
                row.currencyId = line.integer(c.currencyId, u"CurrencyID");
                if (row.currencyId < 1 || row.currencyId > kCurrencyCount)
                    throw Failure(line.where() + QStringLiteral("מזהה המטבע %1 אינו בתחום 1 עד %2")
                                                     .arg(row.currencyId)
                                                     .arg(kCurrencyCount));
                QString& seenCode = state.CurrencyCodes[static_cast<size_t>(row.currencyId)];
                const QString& newCode = code.isNull() ? dash : row.currencyCode;
                if (seenCode != newCode)
                    seenCode = newCode;
                row.detail.CompIndex = compId;
                row.detail.CounterKey = counters.intern(NullToText(counterKey, QString()));
                row.detail.CounterName = counterName;
                state.CurrencyTotals[static_cast<size_t>(row.currencyId)] += foreignAmount;
                ledger.stage(std::move(row));
                if (ledger.stagedCount() >= commitBatch)
                    ledger.commitStaged();
            }

            // A graph-date choice other than the two dates keeps the previous
            // line's date; the first line then has none to keep.
            if (options.graphDate == 0)
                graphDate = valueDate;
            else if (options.graphDate == 1)
                graphDate = dueDate;
            if (!graphDate.isValid())
                throw Failure(line.where() + QStringLiteral("לא נבחר תאריך לגרף"));
            state.periods.add(graphDate, amount);
        }

        ++fetched;
        if (fetched % 5 == 0)
            progress.setFillWidth(fillWidth(fetched, recCount, frameWidth));
        rs.MoveNext();
    }
    ledger.commitStaged();
    progress.setFillWidth(0);
    rs.Close();
    return -1;
}

} // namespace

int ReadTransactions7(const QString& CompPath, const QString& pAccountKey, int pCompID,
                      const JournalOptions& options, LedgerModel& ledger, ProgressSink& progress,
                      QString* failure) {
    if (failure)
        failure->clear();
    if (accountHidden())
        return 0;
    try {
        return read(CompPath, pAccountKey, pCompID, options, ledger, progress);
    } catch (const Failure& error) {
        // The lines read before the failure stay in the grid with their totals.
        ledger.commitStaged();
        if (failure)
            *failure = error.description();
        return 0;
    }
}

} // namespace ardcard
