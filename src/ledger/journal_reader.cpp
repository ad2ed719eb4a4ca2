#include "ledger/journal_reader.h"

#include "common/failure.h"
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

// Turns the lines of the main query into grid rows, in read order: the row
// numbers, the running balance, the counter account and the totals carry
// over from line to line.
class LineMapper {
public:
    LineMapper(const Recordset& rs, const JournalRequest& request)
        : c_(resolveColumns(rs, request.options.incNegdiName)), line_(rs, c_.transId),
          options_(request.options), compId_(request.compId), totals_(request.totals) {}

    const JournalTotals& totals() const { return totals_; }

    // Maps the current line; false for a line without an account key, which
    // is passed over. The row is filled unless the read is graph-only.
    bool map(LedgerRow& row) {
        const QDate valueDate = line_.date(c_.valueDate, u"ValueDate");
        const QDate dueDate = line_.date(c_.dueDate, u"DueDate");
        if (line_.required(c_.accountKey, u"AccountKey").toString().isEmpty())
            return false;
        ++rowNumber_;
        // DebitCredit 0 is a debit line, 1 a credit line; any other value
        // keeps the previous line's sign and counter account.
        const int debitCredit = line_.side(c_.debitCredit);
        if (debitCredit == 0 || debitCredit == 1) {
            const bool debit = debitCredit == 0;
            counterKey_ = line_.value(debit ? c_.transDebId : c_.transCredId);
            sign_ = debit ? 1.0 : -1.0;
            if (options_.incNegdiName)
                counterName_ =
                    counters_.intern(NullToText(line_.value(debit ? c_.dName : c_.cName), dash()));
        }
        const double amount = line_.requiredNumber(c_.suF, u"SuF") * sign_;
        const double foreignAmount = line_.requiredNumber(c_.suFDlr, u"SuFDlr") * sign_;
        balance_ += amount;
        const int fullMatch = line_.integer(c_.fullMatch, u"FullMatch");
        if (!options_.onlyGraph)
            fillRow(row, valueDate, dueDate, amount, foreignAmount, fullMatch);

        // A graph-date choice other than the two dates keeps the previous
        // line's date; the first line then has none to keep.
        if (options_.graphDate == 0)
            graphDate_ = valueDate;
        else if (options_.graphDate == 1)
            graphDate_ = dueDate;
        if (!graphDate_.isValid())
            throw Failure(line_.where() + QStringLiteral("לא נבחר תאריך לגרף"));
        totals_.periods.add(graphDate_, amount);
        return true;
    }

private:
    static const QString& dash() {
        static const QString text = QStringLiteral("-");
        return text;
    }

    void fillRow(LedgerRow& row, QDate valueDate, QDate dueDate, double amount,
                 double foreignAmount, int fullMatch) {
        static const QString space = QStringLiteral(" ");
        row.rowNumber = rowNumber_;
        row.valueDate = valueDate;
        row.batchNo = line_.required(c_.batchNo, u"BatchNo");
        row.transId = line_.required(c_.transId, u"TransID");
        row.dueDate = dueDate;
        row.referance = line_.numberOrZero(c_.referance, u"Referance");
        row.ref2 = line_.numberOrZero(c_.ref2, u"Ref2");
        row.description = NullToText(line_.value(c_.description), space);
        row.amount = amount;
        row.foreignAmount = foreignAmount;
        const QVariant code = line_.value(c_.currencyCode);
        row.currencyCode = code.isNull() ? QString() : codes_.intern(code.toString());
        row.balance = balance_;
        row.costCode = codes_.intern(NullToText(line_.value(c_.costCode), space));
        row.fullMatch = fullMatch;
        row.currencyId = line_.integer(c_.currencyId, u"CurrencyID");
        if (row.currencyId < 1 || row.currencyId > kCurrencyCount)
            throw Failure(line_.where() + QStringLiteral("מזהה המטבע %1 אינו בתחום 1 עד %2")
                                              .arg(row.currencyId)
                                              .arg(kCurrencyCount));
        const auto id = static_cast<size_t>(row.currencyId);
        totals_.currencyCodes[id] = code.isNull() ? dash() : row.currencyCode;
        totals_.currencyTotals[id] += foreignAmount;
        row.detail.CompIndex = compId_;
        row.detail.CounterKey = counters_.intern(NullToText(counterKey_, QString()));
        row.detail.CounterName = counterName_;
    }

    const Columns c_;
    const LineReader line_;
    const JournalOptions options_;
    const int compId_;
    JournalTotals totals_;
    StringPool codes_{256};
    StringPool counters_{4096};
    int rowNumber_ = 0;
    double balance_ = 0.0;
    double sign_ = 0.0;
    QVariant counterKey_;
    QString counterName_;
    QDate graphDate_;
};

// The count query's answer: how many lines the main query will give.
double countLines(Recordset& rs, const JournalRequest& request) {
    rs.Open(
        JournalCountSql(request.accountKey, request.options.onlyOpen, request.options.incNegdiName),
        CursorKind::Dynamic);
    if (rs.Eof())
        return 0.0;
    const QVariant count = rs.value(resolve(rs, QStringLiteral("RecCount")));
    rs.Close();
    return count.isNull() ? 0.0 : count.toDouble();
}

} // namespace

void ReadJournal(const JournalRequest& request, JournalSink& sink) {
    const ConnValues& conn = request.conn;
    Connection connection;
    connection.setTimeout(60);
    connection.open(BuildConnString(conn.ConnServer, conn.ConnUID, conn.ConnPWD, request.compPath,
                                    conn.ConnType));
    Recordset rs(connection);
    const double count = countLines(rs, request);
    sink.counted(count);
    if (count == 0.0)
        return;

    rs.Open(
        JournalMainSql(request.accountKey, request.options.onlyOpen, request.options.incNegdiName),
        CursorKind::Dynamic);
    LineMapper mapper(rs, request);
    const auto batchSize = static_cast<size_t>(
        std::max(kMinCommitBatch, static_cast<qsizetype>(count) / kCommitsPerRead));
    std::vector<LedgerRow> batch;
    const auto deliver = [&] {
        sink.delivered(std::move(batch), mapper.totals());
        batch.clear();
    };
    qint64 fetched = 0;
    try {
        while (!rs.Eof()) {
            LedgerRow row;
            if (mapper.map(row) && !request.options.onlyGraph) {
                batch.push_back(std::move(row));
                if (batch.size() >= batchSize)
                    deliver();
            }
            if (++fetched % 5 == 0)
                sink.progressed(fetched);
            rs.MoveNext();
        }
    } catch (const Failure&) {
        deliver(); // the lines before the failure stay, with their totals
        throw;
    }
    deliver();
    rs.Close();
}

} // namespace ardcard
