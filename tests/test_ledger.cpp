// The ledger: the grid model, the journal SQL, the journal read against real
// SQLite company files, and the fetch loop over several companies.

#include "card/card.h"
#include "common/module_state.h"
#include "demo/demo_builder.h"
#include "host/seams.h"
#include "ledger/fetch_command.h"
#include "ledger/journal_reader.h"
#include "ledger/journal_sql.h"
#include "ledger/ledger_model.h"

#include <QAbstractItemModelTester>
#include <QCheckBox>
#include <QCoreApplication>
#include <QFrame>
#include <QHeaderView>
#include <QPushButton>
#include <QSignalSpy>
#include <QSqlDatabase>
#include <QSqlError>
#include <QSqlQuery>
#include <QTableView>
#include <QTemporaryDir>
#include <QTest>
#include <QUuid>
#include <limits>

using namespace ardcard;

namespace {

// A company database file with the journal tables the read joins, written
// with plain SQL so that each test states exactly which lines exist.
class Company {
public:
    explicit Company(const QString& path) : path_(path), name_(QUuid::createUuid().toString()) {
        {
            QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), name_);
            db.setDatabaseName(path);
            if (!db.open())
                qFatal("cannot create %s", qPrintable(path));
        }
        exec(QStringLiteral(
            "CREATE TABLE JurnalTrans (TransID INTEGER PRIMARY KEY, Type INTEGER, Status "
            "INTEGER, FixedID INTEGER, ValueDate DATETIME, DueDate DATETIME, BatchNo INTEGER, "
            "Referance INTEGER, Ref2 INTEGER, Description TEXT, CostCode TEXT, TransType TEXT, "
            "CurrencyCode TEXT, TransDebID TEXT, TransCredID TEXT)"));
        exec(QStringLiteral("CREATE TABLE JurnalTransMoves (ID INTEGER PRIMARY KEY, TransID "
                            "INTEGER, AccountKey TEXT, SuF REAL, SuFDlr REAL, DebitCredit "
                            "INTEGER, FullMatch INTEGER)"));
        exec(QStringLiteral("CREATE INDEX MovesByAccount ON JurnalTransMoves (AccountKey)"));
        exec(QStringLiteral("CREATE TABLE Currencies (ID INTEGER, CurrencyCode TEXT)"));
        exec(QStringLiteral("CREATE TABLE Accounts (AccountKey TEXT PRIMARY KEY, FullName TEXT, "
                            "Filter TEXT)"));
    }
    ~Company() {
        QSqlDatabase::database(name_).close();
        QSqlDatabase::removeDatabase(name_);
    }

    void exec(const QString& sql) {
        QSqlQuery query(QSqlDatabase::database(name_));
        if (!query.exec(sql))
            qFatal("%s: %s", qPrintable(sql), qPrintable(query.lastError().text()));
    }
    void currency(int id, const QString& code) {
        exec(QStringLiteral("INSERT INTO Currencies VALUES (%1, '%2')").arg(id).arg(code));
    }
    // fullName given as SQL text: a quoted name or NULL.
    void account(const QString& key, const QString& fullNameSql) {
        exec(QStringLiteral("INSERT INTO Accounts VALUES ('%1', %2, '')").arg(key, fullNameSql));
    }
    // Values given as SQL literals, in the table's column order after TransID.
    void trans(int transId, const QString& values) {
        exec(QStringLiteral("INSERT INTO JurnalTrans VALUES (%1, %2)").arg(transId).arg(values));
    }
    void move(int transId, const QString& accountKey, const QString& values) {
        exec(QStringLiteral("INSERT INTO JurnalTransMoves (TransID, AccountKey, SuF, SuFDlr, "
                            "DebitCredit, FullMatch) VALUES (%1, '%2', %3)")
                 .arg(transId)
                 .arg(accountKey, values));
    }
    // An ordinary posted line of account 1001 in currency USD.
    void simpleLine(int transId, const QString& date, double amount) {
        trans(transId, QStringLiteral("0, 1, 0, '%1', '%1', 1, %2, 0, 'l', 'c', '', 'USD', "
                                      "'2001', '3001'")
                           .arg(date)
                           .arg(transId));
        move(transId, QStringLiteral("1001"), QStringLiteral("%1, %1, 0, 0").arg(amount));
    }
    const QString& path() const { return path_; }

private:
    QString path_;
    QString name_;
};

// The fixture company A of the read tests, account 1001:
//   9  debit,  USD, 5 Jan 2024 (due 10 Feb 2024), open
//   10 credit, NIS, 20 Jan 2024 (due 1 Mar 2024), Null Referance/Description/CostCode, matched
//   11 DebitCredit 2, EUR, 31 Dec 2000 (due 15 Jan 2001), credit account with a Null name
//   12 debit,  USD, 1 Jan 2026, debit account missing from Accounts
// plus lines that the query leaves out: unposted, fixed, another type,
// another account.
void fillCompanyA(Company& c) {
    c.currency(1, QStringLiteral("NIS"));
    c.currency(2, QStringLiteral("USD"));
    c.currency(3, QStringLiteral("EUR"));
    c.account(QStringLiteral("1001"), QStringLiteral("'לקוח'"));
    c.account(QStringLiteral("2001"), QStringLiteral("'ספק'"));
    c.account(QStringLiteral("3001"), QStringLiteral("NULL"));
    c.trans(9, QStringLiteral("0, 1, 0, '2024-01-05 00:00:00', '2024-02-10 00:00:00', 7, 123, "
                              "NULL, 'חשבונית', 'A1', '', 'USD', '2001', '3001'"));
    c.move(9, QStringLiteral("1001"), QStringLiteral("1000, 270, 0, 0"));
    c.move(9, QStringLiteral("2001"), QStringLiteral("1000, 270, 1, 0"));
    c.trans(10, QStringLiteral("0, 1, 0, '2024-01-20', '2024-03-01', 7, NULL, 55, NULL, NULL, "
                               "'', 'NIS', '2001', '3001'"));
    c.move(10, QStringLiteral("1001"), QStringLiteral("1234.5, 1234.5, 1, 3"));
    c.trans(11, QStringLiteral("0, 1, 0, '2000-12-31', '2001-01-15', 8, 5, 0, 'x', 'C', '', "
                               "'EUR', '1001', '3001'"));
    c.move(11, QStringLiteral("1001"), QStringLiteral("200, 50, 2, 0"));
    c.trans(12, QStringLiteral("0, 1, 0, '2026-01-01', '2026-01-01', 9, 77, NULL, 'שנה חדשה', "
                               "'B', '', 'USD', '9999', '2001'"));
    c.move(12, QStringLiteral("1001"), QStringLiteral("10, 3, 0, 0"));
    // Left out by the query's conditions.
    c.trans(13, QStringLiteral("0, 0, 0, '2024-01-05', '2024-01-05', 1, 1, 1, 'unposted', 'x', "
                               "'', 'USD', '2001', '3001'"));
    c.move(13, QStringLiteral("1001"), QStringLiteral("1, 1, 0, 0"));
    c.trans(14, QStringLiteral("0, 1, 1, '2024-01-05', '2024-01-05', 1, 1, 1, 'fixed', 'x', "
                               "'', 'USD', '2001', '3001'"));
    c.move(14, QStringLiteral("1001"), QStringLiteral("1, 1, 0, 0"));
    c.trans(15, QStringLiteral("1, 1, 0, '2024-01-05', '2024-01-05', 1, 1, 1, 'type 1', 'x', "
                               "'', 'USD', '2001', '3001'"));
    c.move(15, QStringLiteral("1001"), QStringLiteral("1, 1, 0, 0"));
}

class RecordingProgress final : public ProgressSink {
public:
    explicit RecordingProgress(int width) : width_(width) {}
    int frameWidth() const override { return width_; }
    void setFillWidth(int width) override { widths.append(width); }
    QList<int> widths;

private:
    int width_;
};

QStringList rowCells(const LedgerModel& model, int gridRow) {
    QStringList cells;
    for (int c = 0; c < LedgerModel::kColumns; ++c)
        cells.append(model.cellText(gridRow, c));
    return cells;
}

QStringList cells(const char16_t* tabSeparated) {
    return QString::fromUtf16(tabSeparated).split(u'\t');
}

void resetState() {
    ModuleState& state = moduleState();
    state = ModuleState();
    state.conn.ConnType = 4; // a database file named by the company directory
}

LedgerRow modelRow(int rowNumber, int transId, int batchNo, int compIndex) {
    LedgerRow row;
    row.rowNumber = rowNumber;
    row.transId = transId;
    row.batchNo = batchNo;
    row.valueDate = QDate(2024, 1, 1);
    row.dueDate = QDate(2024, 1, 1);
    row.detail.CompIndex = compIndex;
    row.detail.CounterKey = QString::number(transId * 100);
    return row;
}

} // namespace

class TestLedger : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void init() { resetState(); }

    // ---- the grid model ------------------------------------------------

    void headerRow() {
        LedgerModel model;
        const QStringList expected = {u"שורה"_qs,
                                      u"תאריך          "_qs,
                                      u"מנה     "_qs,
                                      u"תנועה"_qs,
                                      u"תאריך ערך"_qs,
                                      u"אסמכתא 1"_qs,
                                      u"אסמכתא 2"_qs,
                                      u"פרטים                              "_qs,
                                      u"סכום                    "_qs,
                                      u"סכום מטח               "_qs,
                                      u"מט"_qs,
                                      u"יתרה שח                    "_qs,
                                      u"תמחיר"_qs,
                                      u"התאמה"_qs,
                                      u"התאמה $"_qs,
                                      u"הת בנק"_qs,
                                      QString()};
        QCOMPARE(rowCells(model, 0), expected);
        QCOMPARE(model.gridRowCount(), 2);
        QCOMPARE(model.columnCount(), 17);
        QCOMPARE(model.rowCount(), 1); // the blank row
        QCOMPARE(rowCells(model, 1), QStringList(17, QString()));
        QCOMPARE(model.headerData(7, Qt::Horizontal).toString(),
                 u"פרטים                              "_qs);
    }

    // Batch and transaction numbers show as the database's value reads,
    // whatever its type, after copies and a sort as well.
    void batchNumbersShowAsRead_data() {
        QTest::addColumn<QVariant>("value");
        QTest::addColumn<QString>("text");
        QTest::addColumn<bool>("sortsBeforeTen");
        QTest::newRow("int") << QVariant(7) << u"7"_qs << true;
        QTest::newRow("unsigned") << QVariant(42u) << u"42"_qs << false;
        QTest::newRow("most negative 64-bit") << QVariant(std::numeric_limits<qlonglong>::min())
                                              << u"-9223372036854775808"_qs << true;
        QTest::newRow("unsigned beyond signed") << QVariant(std::numeric_limits<qulonglong>::max())
                                                << u"18446744073709551615"_qs << false;
        QTest::newRow("fraction") << QVariant(12.5) << u"12.5"_qs << false;
        QTest::newRow("text") << QVariant(u"B-7"_qs) << u"B-7"_qs << true;
        QTest::newRow("number as text") << QVariant(u" 42 "_qs) << u" 42 "_qs << false;
        QTest::newRow("Null") << QVariant(QMetaType::fromType<qlonglong>()) << QString() << true;
        QTest::newRow("no value") << QVariant() << QString() << true;
    }
    void batchNumbersShowAsRead() {
        QFETCH(QVariant, value);
        QFETCH(QString, text);
        QFETCH(bool, sortsBeforeTen);
        LedgerModel model;
        LedgerRow ten = modelRow(1, 1, 10, 1);
        LedgerRow read = modelRow(2, 2, 0, 1);
        read.batchNo = value;
        const LedgerRow copy = read; // a copy keeps its own value
        read = copy;
        model.append(std::move(ten));
        model.append(copy);
        QCOMPARE(model.cellText(2, 2), text);
        QVERIFY(model.sortNumeric(2));
        QCOMPARE(model.cellText(sortsBeforeTen ? 1 : 2, 2), text);
        QCOMPARE(model.cellText(sortsBeforeTen ? 2 : 1, 2), u"10"_qs);
        QCOMPARE(read.batchNo.toString(), text);
    }

    void appendKeepsBlankRowLast() {
        LedgerModel model;
        QAbstractItemModelTester tester(&model,
                                        QAbstractItemModelTester::FailureReportingMode::QtTest);
        QSignalSpy inserted(&model, &QAbstractItemModel::rowsInserted);
        for (int i = 1; i <= 3; ++i)
            model.stage(modelRow(i, i, 1, 1));
        QCOMPARE(model.gridRowCount(), 2); // staged rows are not in the grid yet
        model.commitStaged();
        QCOMPARE(inserted.count(), 1);
        QCOMPARE(inserted.at(0).at(1).toInt(), 0);
        QCOMPARE(inserted.at(0).at(2).toInt(), 2);
        model.append(modelRow(4, 4, 1, 2));
        QCOMPARE(model.gridRowCount(), 6);
        QCOMPARE(model.cellText(4, 3), u"4"_qs);
        QCOMPARE(model.rowDetail(4).CompIndex, 2);
        QCOMPARE(model.cellText(5, 0), QString());
        QCOMPARE(model.rowDetail(5).CounterKey, QString());
        QCOMPARE(model.data(model.index(4, 0)).toString(), QString()); // blank row
        model.clear();
        QCOMPARE(model.gridRowCount(), 2);
    }

    // A right-to-left grid draws a signed amount as written; the cell text
    // that the outputs read carries no mark.
    void negativeAmountReadsLeftToRight() {
        LedgerModel model;
        LedgerRow row = modelRow(1, 7, 1, 1);
        row.amount = -1234.5;
        row.balance = 99;
        model.append(row);
        QCOMPARE(model.cellText(1, 8), u"-1,234.50"_qs);
        QCOMPARE(model.data(model.index(0, 8)).toString(), u"\u200E-1,234.50"_qs);
        QCOMPARE(model.data(model.index(0, 11)).toString(), u"99.00"_qs);
    }

    void sortByColumn_data() {
        QTest::addColumn<int>("column");
        QTest::addColumn<bool>("sorts");
        QTest::addColumn<QStringList>("transIds");
        QTest::addColumn<QStringList>("counterKeys");
        // Rows are read as transactions 10, 9, 100, 9 (batches 2, 30, 4, 1).
        QTest::newRow("transaction, 9 before 10")
            << 3 << true << QStringList{u"9"_qs, u"9"_qs, u"10"_qs, u"100"_qs}
            << QStringList{u"900"_qs, u"900"_qs, u"1000"_qs, u"10000"_qs};
        QTest::newRow("batch") << 2 << true << QStringList{u"9"_qs, u"10"_qs, u"100"_qs, u"9"_qs}
                               << QStringList{u"900"_qs, u"1000"_qs, u"10000"_qs, u"900"_qs};
        QTest::newRow("date is not sortable")
            << 1 << false << QStringList{u"10"_qs, u"9"_qs, u"100"_qs, u"9"_qs}
            << QStringList{u"1000"_qs, u"900"_qs, u"10000"_qs, u"900"_qs};
        QTest::newRow("details are not sortable")
            << 7 << false << QStringList{u"10"_qs, u"9"_qs, u"100"_qs, u"9"_qs}
            << QStringList{u"1000"_qs, u"900"_qs, u"10000"_qs, u"900"_qs};
    }

    void sortByColumn() {
        QFETCH(int, column);
        QFETCH(bool, sorts);
        QFETCH(QStringList, transIds);
        QFETCH(QStringList, counterKeys);
        LedgerModel model;
        QAbstractItemModelTester tester(&model,
                                        QAbstractItemModelTester::FailureReportingMode::QtTest);
        model.append(modelRow(1, 10, 2, 1));
        model.append(modelRow(2, 9, 30, 1));
        model.append(modelRow(3, 100, 4, 2));
        model.append(modelRow(4, 9, 1, 2));
        const QPersistentModelIndex firstRead = model.index(0, 3);
        QCOMPARE(model.sortNumeric(column), sorts);
        QStringList ids;
        QStringList keys;
        for (int r = 1; r <= 4; ++r) {
            ids.append(model.cellText(r, 3));
            keys.append(model.rowDetail(r).CounterKey);
        }
        QCOMPARE(ids, transIds);
        QCOMPARE(keys, counterKeys);
        QCOMPARE(model.gridRowCount(), 6);
        QCOMPARE(model.cellText(5, 3), QString()); // the blank row stays last
        QCOMPARE(firstRead.data().toString(), u"10"_qs);
    }

    void sortIsStable() {
        LedgerModel model;
        model.append(modelRow(1, 5, 1, 1));
        model.append(modelRow(2, 3, 1, 2));
        model.append(modelRow(3, 5, 1, 3));
        QVERIFY(model.sortNumeric(2)); // every batch is 1: the order read stays
        QCOMPARE(model.rowDetail(1).CompIndex, 1);
        QCOMPARE(model.rowDetail(2).CompIndex, 2);
        QCOMPARE(model.rowDetail(3).CompIndex, 3);
        QVERIFY(model.sortNumeric(3));
        QCOMPARE(model.cellText(1, 0), u"2"_qs);
        QCOMPARE(model.cellText(2, 0), u"1"_qs);
        QCOMPARE(model.cellText(3, 0), u"3"_qs);
        QVERIFY(model.sortNumeric(0));
        QCOMPARE(model.cellText(1, 0), u"1"_qs);
    }

    // ---- the journal SQL -----------------------------------------------

    void journalSql_data() {
        QTest::addColumn<bool>("onlyOpen");
        QTest::addColumn<bool>("names");
        QTest::addColumn<QString>("count");
        QTest::addColumn<QString>("main");
        const QString select =
            u"SELECT JurnalTrans.TransID, JurnalTrans.Type, JurnalTrans.ValueDate, "
            "JurnalTrans.DueDate, JurnalTrans.BatchNo, JurnalTrans.Referance, JurnalTrans.Ref2, "
            "JurnalTrans.Description, JurnalTrans.CostCode, JurnalTrans.TransType, "
            "JurnalTrans.CurrencyCode, JurnalTrans.TransDebID, JurnalTrans.TransCredID, "
            "JurnalTransMoves.AccountKey, JurnalTransMoves.SuF, JurnalTransMoves.SuFDlr, "
            "JurnalTransMoves.DebitCredit, JurnalTransMoves.FullMatch, Currencies.ID As "
            "CurrencyID"_qs;
        const QString where =
            u" WHERE JurnalTrans.Status = 1 And JurnalTrans.FixedID = 0 And JurnalTrans.TransID "
            "= JurnalTransMoves.TransID And JurnalTransMoves.AccountKey = '1001' And "
            "Currencies.CurrencyCode = JurnalTrans.CurrencyCode And JurnalTrans.Type = 0"_qs;
        QTest::newRow("plain")
            << false << false
            << u"SELECT Count(JurnalTrans.TransID) As RecCount FROM JurnalTrans, "
               "JurnalTransMoves, Currencies"_qs +
                   where
            << select + u" FROM JurnalTrans, JurnalTransMoves, Currencies"_qs + where;
        QTest::newRow("open lines")
            << true << false
            << u"SELECT Count(JurnalTrans.TransID) As RecCount FROM JurnalTrans, "
               "JurnalTransMoves, Currencies"_qs +
                   where + u" And (JurnalTransMoves.FullMatch = 0)"_qs
            << select + u" FROM JurnalTrans, JurnalTransMoves, Currencies"_qs + where +
                   u" And (JurnalTransMoves.FullMatch = 0)"_qs;
        QTest::newRow("counter names")
            << false << true
            << u"SELECT Count(JurnalTrans.TransID) As RecCount FROM JurnalTrans, "
               "JurnalTransMoves, Currencies, Accounts CAcc, Accounts DAcc"_qs +
                   where +
                   u" And CAcc.AccountKey = JurnalTrans.TransCredID And DAcc.AccountKey = "
                   "JurnalTrans.TransDebID"_qs
            << select +
                   u", CAcc.FullName As CName, DAcc.FullName As DName FROM JurnalTrans, "
                   "JurnalTransMoves, Currencies, Accounts CAcc, Accounts DAcc"_qs +
                   where +
                   u" And CAcc.AccountKey = JurnalTrans.TransCredID And DAcc.AccountKey = "
                   "JurnalTrans.TransDebID"_qs;
        QTest::newRow("open lines with counter names")
            << true << true
            << u"SELECT Count(JurnalTrans.TransID) As RecCount FROM JurnalTrans, "
               "JurnalTransMoves, Currencies, Accounts CAcc, Accounts DAcc"_qs +
                   where +
                   u" And CAcc.AccountKey = JurnalTrans.TransCredID And DAcc.AccountKey = "
                   "JurnalTrans.TransDebID And (JurnalTransMoves.FullMatch = 0)"_qs
            << select +
                   u", CAcc.FullName As CName, DAcc.FullName As DName FROM JurnalTrans, "
                   "JurnalTransMoves, Currencies, Accounts CAcc, Accounts DAcc"_qs +
                   where +
                   u" And CAcc.AccountKey = JurnalTrans.TransCredID And DAcc.AccountKey = "
                   "JurnalTrans.TransDebID And (JurnalTransMoves.FullMatch = 0)"_qs;
    }

    void journalSql() {
        QFETCH(bool, onlyOpen);
        QFETCH(bool, names);
        QFETCH(QString, count);
        QFETCH(QString, main);
        QCOMPARE(JournalCountSql(u"1001"_qs, onlyOpen, names), count);
        QCOMPARE(JournalMainSql(u"1001"_qs, onlyOpen, names), main);
    }

    // ---- the journal read ----------------------------------------------

    void readCompany() {
        QTemporaryDir dir;
        Company a(dir.filePath(u"a.db"_qs));
        fillCompanyA(a);
        LedgerModel model;
        QAbstractItemModelTester tester(&model,
                                        QAbstractItemModelTester::FailureReportingMode::QtTest);
        NoProgress progress;
        QString failure = u"stale"_qs;
        QCOMPARE(
            ReadTransactions7(a.path(), u"1001"_qs, 1, JournalOptions{}, model, progress, &failure),
            -1);
        QCOMPARE(failure, QString());
        QCOMPARE(model.gridRowCount(), 6);
        QCOMPARE(rowCells(model, 1), cells(u"1\t05/01/24\t7\t9\t10/02/24\t123\t0\tחשבונית\t"
                                           u"1,000.00\t270.00\tUSD\t1,000.00\tA1\t0\t0\t0\t2"));
        QCOMPARE(rowCells(model, 2), cells(u"2\t20/01/24\t7\t10\t01/03/24\t0\t55\t \t"
                                           u"-1,234.50\t-1,234.50\tNIS\t-234.50\t \t3\t0\t0\t1"));
        // DebitCredit 2 keeps the sign and counter account of the line before.
        QCOMPARE(rowCells(model, 3), cells(u"3\t31/12/00\t8\t11\t15/01/01\t5\t0\tx\t"
                                           u"-200.00\t-50.00\tEUR\t-434.50\tC\t0\t0\t0\t3"));
        QCOMPARE(rowCells(model, 4), cells(u"4\t01/01/26\t9\t12\t01/01/26\t77\t0\tשנה חדשה\t"
                                           u"10.00\t3.00\tUSD\t-424.50\tB\t0\t0\t0\t2"));
        QCOMPARE(rowCells(model, 5), QStringList(17, QString()));

        QCOMPARE(model.rowDetail(1).CounterKey, u"2001"_qs);
        QCOMPARE(model.rowDetail(2).CounterKey, u"3001"_qs);
        QCOMPARE(model.rowDetail(3).CounterKey, u"3001"_qs);
        QCOMPARE(model.rowDetail(4).CounterKey, u"9999"_qs);
        for (int r = 1; r <= 4; ++r) {
            QCOMPARE(model.rowDetail(r).CompIndex, 1);
            QCOMPARE(model.rowDetail(r).CounterName, QString());
        }

        const ModuleState& s = moduleState();
        QCOMPARE(s.CurrencyTotals[1], -1234.5);
        QCOMPARE(s.CurrencyTotals[2], 273.0);
        QCOMPARE(s.CurrencyTotals[3], -50.0);
        QCOMPARE(s.CurrencyTotals[4], 0.0);
        QCOMPARE(s.CurrencyCodes[1], u"NIS"_qs);
        QCOMPARE(s.CurrencyCodes[2], u"USD"_qs);
        QCOMPARE(s.CurrencyCodes[3], u"EUR"_qs);
        QCOMPARE(s.CurrencyCodes[4], QString());

        // By transaction date: 5 Jan 2024 is in week 1 (1 Jan 2024 a Monday),
        // 20 Jan 2024 in week 3; 31 Dec 2000 in week 54; 1 Jan 2026 counts too.
        QCOMPARE(s.periods.value(PeriodTotals::Week, 2024, 1), 1000.0);
        QCOMPARE(s.periods.value(PeriodTotals::Week, 2024, 3), -1234.5);
        QCOMPARE(s.periods.value(PeriodTotals::Month, 2024, 1), -234.5);
        QCOMPARE(s.periods.value(PeriodTotals::Quarter, 2024, 1), -234.5);
        QCOMPARE(s.periods.value(PeriodTotals::Week, 2000, 54), -200.0);
        QCOMPARE(s.periods.value(PeriodTotals::Month, 2000, 12), -200.0);
        QCOMPARE(s.periods.value(PeriodTotals::Quarter, 2000, 4), -200.0);
        QCOMPARE(s.periods.value(PeriodTotals::Week, 2026, 1), 10.0);
        QCOMPARE(s.periods.value(PeriodTotals::Month, 2026, 1), 10.0);
        QCOMPARE(s.periods.value(PeriodTotals::Month, 2024, 2), 0.0);
    }

    void readByDueDate() {
        QTemporaryDir dir;
        Company a(dir.filePath(u"a.db"_qs));
        fillCompanyA(a);
        LedgerModel model;
        NoProgress progress;
        JournalOptions options;
        options.graphDate = 1;
        QCOMPARE(ReadTransactions7(a.path(), u"1001"_qs, 1, options, model, progress), -1);
        const PeriodTotals& p = moduleState().periods;
        QCOMPARE(p.value(PeriodTotals::Month, 2024, 1), 0.0);
        QCOMPARE(p.value(PeriodTotals::Month, 2024, 2), 1000.0);
        QCOMPARE(p.value(PeriodTotals::Month, 2024, 3), -1234.5);
        QCOMPARE(p.value(PeriodTotals::Month, 2001, 1), -200.0);
        QCOMPARE(p.value(PeriodTotals::Week, 2001, 3), -200.0); // 15 Jan 2001, a Monday
        QCOMPARE(p.value(PeriodTotals::Month, 2026, 1), 10.0);
    }

    void readWithCounterNames() {
        QTemporaryDir dir;
        Company a(dir.filePath(u"a.db"_qs));
        fillCompanyA(a);
        LedgerModel model;
        NoProgress progress;
        JournalOptions options;
        options.incNegdiName = true;
        QCOMPARE(ReadTransactions7(a.path(), u"1001"_qs, 3, options, model, progress), -1);
        // Transaction 12 names a debit account missing from Accounts: not read.
        QCOMPARE(model.gridRowCount(), 5);
        QCOMPARE(model.cellText(3, 3), u"11"_qs);
        QCOMPARE(model.rowDetail(1).CounterKey, u"2001"_qs);
        QCOMPARE(model.rowDetail(1).CounterName, u"ספק"_qs);
        QCOMPARE(model.rowDetail(2).CounterKey, u"3001"_qs);
        QCOMPARE(model.rowDetail(2).CounterName, u"-"_qs); // a Null FullName
        QCOMPARE(model.rowDetail(3).CounterName, u"-"_qs);
        QCOMPARE(model.rowDetail(3).CompIndex, 3);
    }

    void readOpenLinesOnly() {
        QTemporaryDir dir;
        Company a(dir.filePath(u"a.db"_qs));
        fillCompanyA(a);
        LedgerModel model;
        NoProgress progress;
        JournalOptions options;
        options.onlyOpen = true;
        QCOMPARE(ReadTransactions7(a.path(), u"1001"_qs, 1, options, model, progress), -1);
        QCOMPARE(model.gridRowCount(), 5);
        // Without the matched credit line, line 11 follows the debit line 9.
        QCOMPARE(rowCells(model, 2), cells(u"2\t31/12/00\t8\t11\t15/01/01\t5\t0\tx\t"
                                           u"200.00\t50.00\tEUR\t1,200.00\tC\t0\t0\t0\t3"));
        QCOMPARE(model.rowDetail(2).CounterKey, u"2001"_qs);
        QCOMPARE(model.cellText(3, 11), u"1,210.00"_qs);
        for (int r = 1; r <= 3; ++r)
            QCOMPARE(model.cellText(r, 13), u"0"_qs);
    }

    void readGraphOnly() {
        QTemporaryDir dir;
        Company a(dir.filePath(u"a.db"_qs));
        fillCompanyA(a);
        LedgerModel model;
        RecordingProgress progress(100);
        JournalOptions options;
        options.onlyGraph = true;
        QCOMPARE(ReadTransactions7(a.path(), u"1001"_qs, 1, options, model, progress), -1);
        QCOMPARE(model.gridRowCount(), 2);
        const ModuleState& s = moduleState();
        for (int id = 1; id <= kCurrencyCount; ++id) {
            QCOMPARE(s.CurrencyTotals[static_cast<size_t>(id)], 0.0);
            QCOMPARE(s.CurrencyCodes[static_cast<size_t>(id)], QString());
        }
        QCOMPARE(s.periods.value(PeriodTotals::Month, 2024, 1), -234.5);
        QCOMPARE(s.periods.value(PeriodTotals::Week, 2000, 54), -200.0);
        // Four lines: the bar is set at the start only, not at a fifth line.
        QCOMPARE(progress.widths, (QList<int>{0, 0, 0}));
    }

    void readNoLines() {
        QTemporaryDir dir;
        Company a(dir.filePath(u"a.db"_qs));
        fillCompanyA(a);
        LedgerModel model;
        RecordingProgress progress(100);
        QCOMPARE(ReadTransactions7(a.path(), u"5555"_qs, 1, JournalOptions{}, model, progress), -1);
        QCOMPARE(model.gridRowCount(), 2);
        QCOMPARE(moduleState().periods.yearsDescending(PeriodTotals::Month), std::vector<int>{});
        QCOMPARE(progress.widths, QList<int>{0});
    }

    void hiddenAccount_data() {
        QTest::addColumn<QString>("hidden");
        QTest::addColumn<QString>("accountFilter");
        QTest::addColumn<int>("result");
        QTest::addColumn<int>("rows");
        QTest::newRow("same filter, other case") << u"Secret"_qs << u"sECRET"_qs << 0 << 0;
        QTest::newRow("other filter") << u"Secret"_qs << u"Open"_qs << -1 << 4;
        QTest::newRow("no hidden filter") << QString() << QString() << -1 << 4;
    }

    void hiddenAccount() {
        QFETCH(QString, hidden);
        QFETCH(QString, accountFilter);
        QFETCH(int, result);
        QFETCH(int, rows);
        QTemporaryDir dir;
        Company a(dir.filePath(u"a.db"_qs));
        fillCompanyA(a);
        moduleState().company.HiddenAccountsFilter = hidden;
        moduleState().CurrentAccountFilter = accountFilter;
        moduleState().CurrencyTotals[2] = 5.0;
        LedgerModel model;
        NoProgress progress;
        QString failure;
        QCOMPARE(
            ReadTransactions7(a.path(), u"1001"_qs, 1, JournalOptions{}, model, progress, &failure),
            result);
        QCOMPARE(failure, QString());
        QCOMPARE(model.dataRowCount(), rows);
        QCOMPARE(moduleState().CurrencyTotals[2], rows ? 278.0 : 5.0);
    }

    void nullValueDateEndsTheRead() {
        QTemporaryDir dir;
        Company b(dir.filePath(u"b.db"_qs));
        b.currency(2, u"USD"_qs);
        b.simpleLine(1, u"2024-01-01"_qs, 5);
        b.simpleLine(2, u"2024-01-02"_qs, 6);
        b.simpleLine(3, u"2024-01-03"_qs, 7);
        b.exec(u"UPDATE JurnalTrans SET ValueDate = NULL WHERE TransID = 3"_qs);
        b.simpleLine(4, u"2024-01-04"_qs, 8);
        LedgerModel model;
        RecordingProgress progress(100);
        QString failure;
        QCOMPARE(
            ReadTransactions7(b.path(), u"1001"_qs, 1, JournalOptions{}, model, progress, &failure),
            0);
        QVERIFY2(failure.contains(u"ValueDate"_qs), qPrintable(failure));
        QVERIFY2(failure.contains(u"3"_qs), qPrintable(failure));
        QCOMPARE(model.gridRowCount(), 4); // the two lines before stay
        QCOMPARE(model.cellText(2, 11), u"11.00"_qs);
        QCOMPARE(moduleState().CurrencyTotals[2], 11.0);
        QCOMPARE(moduleState().periods.value(PeriodTotals::Month, 2024, 1), 11.0);
        QCOMPARE(progress.widths, (QList<int>{0, 0}));
    }

    void missingDatabaseIsReported() {
        QTemporaryDir dir;
        LedgerModel model;
        NoProgress progress;
        QString failure;
        QCOMPARE(ReadTransactions7(dir.filePath(u"none.db"_qs), u"1001"_qs, 1, JournalOptions{},
                                   model, progress, &failure),
                 0);
        QVERIFY(!failure.isEmpty());
        QCOMPARE(model.gridRowCount(), 2);
    }

    void currencyIdOutOfRange() {
        QTemporaryDir dir;
        Company b(dir.filePath(u"b.db"_qs));
        b.currency(2, u"USD"_qs);
        b.currency(23, u"XYZ"_qs);
        b.simpleLine(1, u"2024-01-01"_qs, 5);
        b.simpleLine(2, u"2024-01-02"_qs, 6);
        b.exec(u"UPDATE JurnalTrans SET CurrencyCode = 'XYZ' WHERE TransID = 2"_qs);
        LedgerModel model;
        NoProgress progress;
        QString failure;
        QCOMPARE(
            ReadTransactions7(b.path(), u"1001"_qs, 1, JournalOptions{}, model, progress, &failure),
            0);
        QVERIFY2(failure.contains(u"23"_qs), qPrintable(failure));
        QCOMPARE(model.dataRowCount(), 1);
    }

    void progressWidths_data() {
        QTest::addColumn<int>("lines");
        QTest::addColumn<int>("frame");
        QTest::addColumn<QList<int>>("widths");
        // 5/12 and 10/12 of 100 are 41.67 and 83.33.
        QTest::newRow("12 lines") << 12 << 100 << QList<int>{0, 0, 42, 83, 0};
        // A quarter of 10 is 2.5 and three quarters 7.5: halves go to the even width.
        QTest::newRow("20 lines") << 20 << 10 << QList<int>{0, 0, 2, 5, 8, 10, 0};
    }

    void progressWidths() {
        QFETCH(int, lines);
        QFETCH(int, frame);
        QFETCH(QList<int>, widths);
        QTemporaryDir dir;
        Company p(dir.filePath(u"p.db"_qs));
        p.currency(2, u"USD"_qs);
        for (int i = 1; i <= lines; ++i)
            p.simpleLine(i, u"2024-02-01"_qs, i);
        LedgerModel model;
        RecordingProgress progress(frame);
        QCOMPARE(ReadTransactions7(p.path(), u"1001"_qs, 1, JournalOptions{}, model, progress), -1);
        QCOMPARE(progress.widths, widths);
        QCOMPARE(model.dataRowCount(), lines);
    }

    // ---- the fetch over several companies ------------------------------

    void twoCompanies() {
        QTemporaryDir dir;
        Company a(dir.filePath(u"a.db"_qs));
        fillCompanyA(a);
        Company c(dir.filePath(u"c.db"_qs));
        c.currency(2, u"USD"_qs);
        c.simpleLine(1, u"2024-01-10"_qs, 100);
        c.simpleLine(2, u"2024-01-11"_qs, 50);

        LedgerModel model;
        InitLedgerData(model);
        NoProgress progress;
        QStringList read;
        FetchSources sources;
        sources.includeCounterNames = [] { return false; };
        sources.directoryOptions = [] { return JournalOptions{}; };
        sources.readDirectory = [&](const QString& path, const QString& key, int compId,
                                    const JournalOptions& options) {
            read.append(path);
            return ReadTransactions7(path, key, compId, options, model, progress);
        };
        const QString key = ReadAllTransactions(a.path() + u';' + c.path(), u"10'0\"1"_qs, sources);
        QCOMPARE(key, u"1001"_qs);
        QCOMPARE(read, (QStringList{a.path(), c.path()}));
        QCOMPARE(moduleState().CompanyDirCount, 2);
        QCOMPARE(moduleState().CompanyDirList.at(2), c.path());

        QCOMPARE(model.gridRowCount(), 8);
        QCOMPARE(model.cellText(4, 11), u"-424.50"_qs);
        // The second company's lines start again at row 1 and balance 0.
        QCOMPARE(rowCells(model, 5), cells(u"1\t10/01/24\t1\t1\t10/01/24\t1\t0\tl\t"
                                           u"100.00\t100.00\tUSD\t100.00\tc\t0\t0\t0\t2"));
        QCOMPARE(model.cellText(6, 11), u"150.00"_qs);
        QCOMPARE(model.rowDetail(4).CompIndex, 1);
        QCOMPARE(model.rowDetail(5).CompIndex, 2);
        QCOMPARE(model.rowDetail(6).CompIndex, 2);
        // Currency totals cover both companies: 270 + 3 in A, 150 in C.
        QCOMPARE(moduleState().CurrencyTotals[2], 423.0);
        QCOMPARE(moduleState().CurrencyTotals[1], -1234.5);
        QCOMPARE(moduleState().periods.value(PeriodTotals::Month, 2024, 1), -84.5);

        // Laying the grid out afresh zeroes every total but keeps the codes.
        InitLedgerData(model);
        QCOMPARE(model.gridRowCount(), 2);
        QCOMPARE(moduleState().CurrencyTotals[2], 0.0);
        QCOMPARE(moduleState().periods.value(PeriodTotals::Month, 2024, 1), 0.0);
        QCOMPARE(moduleState().CurrencyCodes[2], u"USD"_qs);
    }

    void optionsReadPerDirectory() {
        QTemporaryDir dir;
        QStringList paths;
        int namesAsked = 0;
        QList<bool> namesSeen;
        int optionsAsked = 0;
        FetchSources sources;
        sources.includeCounterNames = [&] {
            ++namesAsked;
            return true;
        };
        sources.directoryOptions = [&] {
            JournalOptions o;
            o.graphDate = ++optionsAsked;
            return o;
        };
        QList<int> graphDates;
        QList<int> ids;
        sources.readDirectory = [&](const QString& path, const QString&, int compId,
                                    const JournalOptions& o) {
            paths.append(path);
            ids.append(compId);
            graphDates.append(o.graphDate);
            namesSeen.append(o.incNegdiName);
            return -1;
        };
        ReadAllTransactions(u"x, y;z"_qs, u"1"_qs, sources);
        QCOMPARE(paths, (QStringList{u"x"_qs, u" y"_qs, u"z"_qs}));
        QCOMPARE(ids, (QList<int>{1, 2, 3}));
        QCOMPARE(namesAsked, 1);
        QCOMPARE(graphDates, (QList<int>{1, 2, 3}));
        QCOMPARE(namesSeen, (QList<bool>{true, true, true}));

        paths.clear();
        ReadAllTransactions(QString(), u"1"_qs, sources);
        QCOMPARE(paths, QStringList{});
        QCOMPARE(moduleState().CompanyDirCount, 0);
    }

    void stopBetweenCompanies() {
        QTemporaryDir dir;
        Company a(dir.filePath(u"a.db"_qs));
        fillCompanyA(a);
        Company b(dir.filePath(u"b.db"_qs));
        b.currency(2, u"USD"_qs);
        b.simpleLine(1, u"2024-01-10"_qs, 100);
        Company c(dir.filePath(u"c.db"_qs));
        c.currency(2, u"USD"_qs);
        c.simpleLine(1, u"2024-01-10"_qs, 100);

        LedgerModel model;
        InitLedgerData(model);
        NoProgress progress;
        QList<int> read;
        bool stoppedDuringRead = true;
        FetchSources sources;
        sources.readDirectory = [&](const QString& path, const QString& key, int compId,
                                    const JournalOptions& options) {
            read.append(compId);
            if (compId == 2) {
                // A stop click arriving while the second company is read: it
                // waits in the event queue until the fetch yields.
                QMetaObject::invokeMethod(
                    QCoreApplication::instance(), [] { moduleState().StopFlag = true; },
                    Qt::QueuedConnection);
            }
            const int result = ReadTransactions7(path, key, compId, options, model, progress);
            if (compId == 2)
                stoppedDuringRead = moduleState().StopFlag;
            return result;
        };
        ReadAllTransactions(a.path() + u';' + b.path() + u';' + c.path(), u"1001"_qs, sources);
        QCOMPARE(read, (QList<int>{1, 2}));
        QVERIFY(!stoppedDuringRead); // the read itself is never interrupted
        QVERIFY(moduleState().StopFlag);
        QCOMPARE(model.dataRowCount(), 5);
        QCOMPARE(model.rowDetail(5).CompIndex, 2);
    }

    // ---- the card's fetch ----------------------------------------------

    void cardFetchTwoCompanies() {
        QTemporaryDir dir;
        const QString a = dir.filePath(u"a.db"_qs);
        const QString b = dir.filePath(u"b.db"_qs);
        demo::BuildLedgerCompany(a, u"1001"_qs, 12);
        demo::BuildLedgerCompany(b, u"1001"_qs, 3);
        host::MessageRecorder messages;
        host::ScopedSeams seams(&messages, nullptr);
        Card card;
        resetState();
        moduleState().CompanyDirText = a + u';' + b;
        card.setAccountKey(u" 1001 "_qs);
        card.findChild<QPushButton*>(u"ShowTransButt"_qs)->click();

        const LedgerModel& model = card.ledger();
        QCOMPARE(messages.messages().size(), 0);
        QCOMPARE(model.gridRowCount(), 17);
        QCOMPARE(model.cellText(12, 0), u"12"_qs);
        QCOMPARE(model.cellText(13, 0), u"1"_qs);
        QCOMPARE(model.rowDetail(12).CompIndex, 1);
        QCOMPARE(model.rowDetail(13).CompIndex, 2);
        QCOMPARE(model.cellText(16, 0), QString());
        QCOMPARE(moduleState().CompanyDirCount, 2);
        QVERIFY(card.findChild<QPushButton*>(u"PrintButt"_qs)->isEnabled());
        QVERIFY(card.findChild<QPushButton*>(u"ExcelButt"_qs)->isEnabled());
        QVERIFY(card.findChild<QPushButton*>(u"CmdGraph"_qs)->isEnabled());
        QCOMPARE(card.findChild<QFrame*>(u"ProgressFill"_qs)->width(), 0);

        // A header click on the row-number column sorts, the blank row staying last.
        QHeaderView* header = card.findChild<QTableView*>(u"DocLines"_qs)->horizontalHeader();
        Q_EMIT header->sectionClicked(0);
        QCOMPARE(model.cellText(1, 0), u"1"_qs);
        QCOMPARE(model.cellText(2, 0), u"1"_qs);
        QCOMPARE(model.rowDetail(1).CompIndex, 1);
        QCOMPARE(model.rowDetail(2).CompIndex, 2);
        QCOMPARE(model.cellText(16, 0), QString());

        // An empty key text changes nothing.
        card.setAccountKey(QString());
        card.findChild<QPushButton*>(u"ShowTransButt"_qs)->click();
        QCOMPARE(model.gridRowCount(), 17);
    }

    void cardReadFailureShowsMessage() {
        QTemporaryDir dir;
        const QString good = dir.filePath(u"good.db"_qs);
        demo::BuildLedgerCompany(good, u"1001"_qs, 2);
        host::MessageRecorder messages;
        host::ScopedSeams seams(&messages, nullptr);
        Card card;
        resetState();
        moduleState().CompanyDirText = dir.filePath(u"missing.db"_qs) + u';' + good;
        card.setAccountKey(u"1001"_qs);
        card.findChild<QPushButton*>(u"ShowTransButt"_qs)->click();
        QCOMPARE(messages.messages().size(), 1);
        QCOMPARE(messages.messages().at(0).title, u"תקלה"_qs);
        QCOMPARE(messages.messages().at(0).icon, host::MessageIcon::Information);
        // The fetch goes on with the next company.
        QCOMPARE(card.ledger().dataRowCount(), 2);
        QCOMPARE(card.ledger().rowDetail(1).CompIndex, 2);
    }

    void cardStopBeforeFirstRead() {
        QTemporaryDir dir;
        const QString a = dir.filePath(u"a.db"_qs);
        demo::BuildLedgerCompany(a, u"1001"_qs, 4);
        host::MessageRecorder messages;
        host::ScopedSeams seams(&messages, nullptr);
        Card card;
        resetState();
        moduleState().CompanyDirText = a;
        card.setAccountKey(u"1001"_qs);
        // A stop click waiting in the queue is handled at the first yield.
        QPushButton* stop = card.findChild<QPushButton*>(u"CmdStop"_qs);
        QMetaObject::invokeMethod(stop, &QPushButton::click, Qt::QueuedConnection);
        card.findChild<QPushButton*>(u"ShowTransButt"_qs)->click();
        QCOMPARE(card.ledger().gridRowCount(), 2);
        QVERIFY(!card.findChild<QPushButton*>(u"PrintButt"_qs)->isEnabled());
        QVERIFY(moduleState().StopFlag);
    }

    void cardGraphOnly() {
        QTemporaryDir dir;
        const QString a = dir.filePath(u"a.db"_qs);
        demo::BuildLedgerCompany(a, u"1001"_qs, 6);
        host::MessageRecorder messages;
        host::ScopedSeams seams(&messages, nullptr);
        Card card;
        resetState();
        moduleState().CompanyDirText = a;
        card.findChild<QCheckBox*>(u"ChkOnlyGraph"_qs)->setChecked(true);
        card.setAccountKey(u"1001"_qs);
        card.findChild<QPushButton*>(u"ShowTransButt"_qs)->click();
        QCOMPARE(card.ledger().gridRowCount(), 2);
        QVERIFY(!moduleState().periods.yearsDescending(PeriodTotals::Month).empty());
        QVERIFY(card.findChild<QPushButton*>(u"PrintButt"_qs)->isEnabled());
    }
};

QTEST_MAIN(TestLedger)
#include "test_ledger.moc"
