// The demo companies and the fixture writer, read back through the system's
// own data layer: every query the card and the information pages send must
// run on them, and the data they promise must be there.

#include "common/failure.h"
#include "connection/conn_string.h"
#include "connection/database.h"
#include "demo/demo_builder.h"

#include <QCryptographicHash>
#include <QDir>
#include <QTemporaryDir>
#include <QtTest>

using ardcard::BuildConnString;
using ardcard::Failure;
using ardcard::Recordset;
using namespace ardcard::demo;

namespace {

const QString kJournalTables = QStringLiteral(" FROM JurnalTrans, JurnalTransMoves, Currencies");
const QString kNameTables = QStringLiteral(", Accounts CAcc, Accounts DAcc");

QString journalCondition(const QString& key, bool names, bool openOnly) {
    QString sql = QStringLiteral(" WHERE JurnalTrans.Status = 1 And JurnalTrans.FixedID = 0"
                                 " And JurnalTrans.TransID = JurnalTransMoves.TransID"
                                 " And JurnalTransMoves.AccountKey = '") +
                  key +
                  QStringLiteral("' And Currencies.CurrencyCode = JurnalTrans.CurrencyCode"
                                 " And JurnalTrans.Type = 0");
    if (names)
        sql += QStringLiteral(" And CAcc.AccountKey = JurnalTrans.TransCredID"
                              " And DAcc.AccountKey = JurnalTrans.TransDebID");
    if (openOnly)
        sql += QStringLiteral(" And (JurnalTransMoves.FullMatch = 0)");
    return sql;
}

QString journalCountSql(const QString& key, bool names, bool openOnly) {
    return QStringLiteral("SELECT Count(JurnalTrans.TransID) As RecCount") + kJournalTables +
           (names ? kNameTables : QString()) + journalCondition(key, names, openOnly);
}

QString journalSql(const QString& key, bool names, bool openOnly) {
    QString sql = QStringLiteral(
        "SELECT JurnalTrans.TransID, JurnalTrans.Type, JurnalTrans.ValueDate, JurnalTrans.DueDate"
        ", JurnalTrans.BatchNo, JurnalTrans.Referance, JurnalTrans.Ref2, JurnalTrans.Description"
        ", JurnalTrans.CostCode, JurnalTrans.TransType, JurnalTrans.CurrencyCode"
        ", JurnalTrans.TransDebID, JurnalTrans.TransCredID, JurnalTransMoves.AccountKey"
        ", JurnalTransMoves.SuF, JurnalTransMoves.SuFDlr, JurnalTransMoves.DebitCredit"
        ", JurnalTransMoves.FullMatch, Currencies.ID As CurrencyID");
    if (names)
        sql += QStringLiteral(", CAcc.FullName As CName, DAcc.FullName As DName");
    return sql + kJournalTables + (names ? kNameTables : QString()) +
           journalCondition(key, names, openOnly);
}

// The first column of the first row.
QVariant scalar(const QString& sql, const QString& connStr) {
    Recordset rs;
    rs.Open(sql, connStr);
    if (rs.Eof())
        return {};
    return rs.value(0);
}

int rowCount(const QString& sql, const QString& connStr) {
    Recordset rs;
    rs.Open(sql, connStr);
    int rows = 0;
    for (; !rs.Eof(); rs.MoveNext())
        ++rows;
    return rows;
}

// A digest of every row of every table, in key order.
QByteArray contentDigest(const QString& connStr) {
    const QStringList tables = {QStringLiteral("CompanyDefenitions"),
                                QStringLiteral("AccSortNames"),
                                QStringLiteral("AgentWarehouseNames"),
                                QStringLiteral("Accounts"),
                                QStringLiteral("Currencies"),
                                QStringLiteral("JurnalTrans"),
                                QStringLiteral("JurnalTransMoves"),
                                QStringLiteral("ExtraNoteNames"),
                                QStringLiteral("ExtraNotes"),
                                QStringLiteral("ExtraSumNames"),
                                QStringLiteral("ExtraSums"),
                                QStringLiteral("ExtraDateNames"),
                                QStringLiteral("ExtraDates"),
                                QStringLiteral("CRMContact"),
                                QStringLiteral("Items"),
                                QStringLiteral("AlterKeys"),
                                QStringLiteral("PriceListNames"),
                                QStringLiteral("PriceLists"),
                                QStringLiteral("SpecialPrices"),
                                QStringLiteral("SpecialPricesMoves"),
                                QStringLiteral("AlternativeItems"),
                                QStringLiteral("TreeTypes"),
                                QStringLiteral("Trees"),
                                QStringLiteral("DocumentsDef")};
    QCryptographicHash hash(QCryptographicHash::Sha256);
    for (const QString& table : tables) {
        Recordset rs;
        rs.Open(QStringLiteral("SELECT * FROM %1 ORDER BY 1, 2").arg(table), connStr);
        hash.addData(table.toUtf8());
        for (; !rs.Eof(); rs.MoveNext()) {
            // The layer tells the end of a row by refusing the next column.
            for (int i = 0;; ++i) {
                QVariant v;
                try {
                    v = rs.value(i);
                } catch (const Failure&) {
                    break;
                }
                hash.addData(v.isNull() ? QByteArray("<null>") : v.toString().toUtf8());
                hash.addData("|");
            }
            hash.addData("\n");
        }
    }
    return hash.result().toHex();
}

} // namespace

class TestDemo : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();

    void schemaStatements();
    void schemaForPostgreSql();

    void demoPromises();
    void accountLookupQueries_data();
    void accountLookupQueries();
    void accountRowQuery();
    void companyDetailsQuery();
    void journalQueries_data();
    void journalQueries();
    void journalNamesJoinDropsMissingCounterAccounts();
    void journalDatesReadAsDates();
    void demoAccountInBothCompanies();
    void connectionCheckQueries();
    void itemPageQueries_data();
    void itemPageQueries();
    void accountPageQueries_data();
    void accountPageQueries();
    void documentTypesQuery();

    void keysCompareWithoutCase();
    void writerWritesNullAndCommitsOnDestruction();
    void writerFailsWithDriverText();
    void writerRefusesMissingFile();
    void createReplacesExistingFile();
    void ledgerCompanyHasExactLineCount();
    void buildsAreDeterministic();

private:
    QString connStr(const QString& file = QStringLiteral("demo.db")) const {
        return BuildConnString(dir_.path(), QString(), QString(), file, 4);
    }

    QTemporaryDir dir_;
};

void TestDemo::initTestCase() {
    QVERIFY(dir_.isValid());
    BuildDemoCompany(dir_.path());
    QVERIFY(QFileInfo::exists(dir_.filePath(QStringLiteral("demo.db"))));
    QVERIFY(QFileInfo::exists(dir_.filePath(QStringLiteral("demo2.db"))));
}

void TestDemo::schemaStatements() {
    const QStringList statements = SchemaStatements(Dialect::Sqlite);
    // 24 tables, 6 indexes, 1 view.
    QCOMPARE(statements.size(), 31);
    for (const QString& s : statements) {
        QVERIFY2(s.startsWith(QStringLiteral("CREATE ")), qPrintable(s));
        QVERIFY2(!s.contains(u';'), qPrintable(s));
        QVERIFY2(!s.contains(QStringLiteral("--")), qPrintable(s));
    }
    QVERIFY(SchemaSql(Dialect::Sqlite).contains(QStringLiteral("AccountKey TEXT COLLATE NOCASE")));
}

void TestDemo::schemaForPostgreSql() {
    const QString sql = SchemaSql(Dialect::PostgreSql);
    QVERIFY(!sql.contains(QStringLiteral("COLLATE")));
    QVERIFY(sql.contains(QStringLiteral("    AccountKey TEXT,\n")));
    QVERIFY(sql.contains(QStringLiteral("CREATE VIEW PriceListsLastDateWithSub AS")));
    QCOMPARE(SchemaStatements(Dialect::PostgreSql).size(), 31);
}

void TestDemo::demoPromises() {
    QVERIFY(scalar(QStringLiteral("SELECT Count(*) FROM Accounts"), connStr()).toInt() >= 200);
    QVERIFY(scalar(QStringLiteral("SELECT Count(*) FROM JurnalTransMoves"), connStr()).toInt() >=
            5000);
    QVERIFY(
        scalar(QStringLiteral("SELECT Count(*) FROM Accounts WHERE Dumi <> 0"), connStr()).toInt() >
        0);
    // Hidden accounts: the filter in the same and in other letter case.
    QCOMPARE(scalar(QStringLiteral("SELECT Count(*) FROM Accounts WHERE Filter = 'PRV'"), connStr())
                 .toInt(),
             2);
    QCOMPARE(
        rowCount(QStringLiteral("SELECT Accounts.ID FROM Accounts, CompanyDefenitions"
                                " WHERE CompanyDefenitions.ID = 1"
                                " AND Accounts.Filter = CompanyDefenitions.HiddenAccountsFilter"),
                 connStr()),
        2);
    QVERIFY(scalar(QStringLiteral("SELECT Min(SuF) FROM JurnalTransMoves"), connStr()).toDouble() >
            0);
    QCOMPARE(
        rowCount(QStringLiteral("SELECT DISTINCT DebitCredit FROM JurnalTransMoves"), connStr()),
        2);
    QCOMPARE(rowCount(QStringLiteral("SELECT DISTINCT CurrencyCode FROM JurnalTrans"), connStr()),
             5);
    QVERIFY(scalar(QStringLiteral("SELECT Count(*) FROM JurnalTransMoves WHERE FullMatch = 0"),
                   connStr())
                .toInt() > 0);
    QVERIFY(scalar(QStringLiteral("SELECT Count(*) FROM JurnalTransMoves WHERE FullMatch <> 0"),
                   connStr())
                .toInt() > 0);
    for (const QString& excluded : {QStringLiteral("Status <> 1"), QStringLiteral("FixedID <> 0"),
                                    QStringLiteral("Type <> 0")})
        QVERIFY2(
            scalar(QStringLiteral("SELECT Count(*) FROM JurnalTrans WHERE ") + excluded, connStr())
                    .toInt() > 0,
            qPrintable(excluded));
    QCOMPARE(scalar(QStringLiteral("SELECT Min(ValueDate) FROM JurnalTrans"), connStr()).toString(),
             QStringLiteral("2019-01-01"));
    QCOMPARE(scalar(QStringLiteral("SELECT Max(ValueDate) FROM JurnalTrans"), connStr())
                 .toString()
                 .left(4),
             QStringLiteral("2026"));
    QCOMPARE(scalar(QStringLiteral("SELECT Count(*) FROM Currencies"), connStr()).toInt(), 5);
}

void TestDemo::accountLookupQueries_data() {
    QTest::addColumn<QString>("sql");
    QTest::addColumn<bool>("found");
    QTest::newRow("first") << QStringLiteral(
                                  "SELECT Min(ID) As StartID FROM Accounts WHERE Dumi = 0")
                           << true;
    QTest::newRow("last") << QStringLiteral(
                                 "SELECT Max(ID) As StartID FROM Accounts WHERE Dumi = 0")
                          << true;
    QTest::newRow("next")
        << QStringLiteral("SELECT Min(ID) As StartID FROM Accounts WHERE Dumi = 0 And ID > 57")
        << true;
    QTest::newRow("previous")
        << QStringLiteral("SELECT Max(ID) As StartID FROM Accounts WHERE Dumi = 0 And ID < 57")
        << true;
    QTest::newRow("previous of the first")
        << QStringLiteral("SELECT Max(ID) As StartID FROM Accounts WHERE Dumi = 0 And ID < 0")
        << false;
    QTest::newRow("key") << QStringLiteral("SELECT Min(ID) As StartID FROM Accounts WHERE Dumi = 0"
                                           " And AccountKey = '10001'")
                         << true;
    QTest::newRow("header key is never chosen")
        << QStringLiteral("SELECT Min(ID) As StartID FROM Accounts WHERE Dumi = 0"
                          " And AccountKey = 'H100'")
        << false;
    QTest::newRow("name after next")
        << QStringLiteral("SELECT Min(ID) As StartID FROM Accounts WHERE Dumi = 0 And ID > 57"
                          " And FullName Like '%בע\"מ%'")
        << true;
    QTest::newRow("telephone") << QStringLiteral(
                                      "SELECT Min(ID) As StartID FROM Accounts WHERE Dumi = 0"
                                      " And Phone Like '%03-%'")
                               << true;
    QTest::newRow("address") << QStringLiteral(
                                    "SELECT Min(ID) As StartID FROM Accounts WHERE Dumi = 0"
                                    " And Address Like '%הרצל%'")
                             << true;
    QTest::newRow("details") << QStringLiteral(
                                    "SELECT Min(ID) As StartID FROM Accounts WHERE Dumi = 0"
                                    " And Details Like '%שוטף%'")
                             << true;
    QTest::newRow("empty name search")
        << QStringLiteral("SELECT Min(ID) As StartID FROM Accounts WHERE Dumi = 0"
                          " And FullName Like '%%'")
        << true;
}

void TestDemo::accountLookupQueries() {
    QFETCH(QString, sql);
    QFETCH(bool, found);
    Recordset rs;
    rs.Open(sql, connStr());
    QVERIFY(!rs.Eof());
    QCOMPARE(!rs.isNull(QStringLiteral("StartID")), found);
}

void TestDemo::accountRowQuery() {
    const QVariant id = scalar(QStringLiteral("SELECT Min(ID) As StartID FROM Accounts"
                                              " WHERE Dumi = 0 And AccountKey = '10001'"),
                               connStr());
    QVERIFY(id.toInt() > 0);
    Recordset rs;
    rs.Open(QStringLiteral("SELECT AccountKey, FullName, Phone, Filter, Obligo, Balance"
                           ", Address, Details, City, Zip, Delivery, Country, Agent"
                           " FROM Accounts WHERE ID = ") +
                QString::number(id.toInt()),
            connStr());
    QVERIFY(!rs.Eof());
    QCOMPARE(rs.field(QStringLiteral("AccountKey")).toString(), QStringLiteral("10001"));
    QVERIFY(!rs.field(QStringLiteral("FullName")).toString().isEmpty());
    QVERIFY(!rs.isNull(QStringLiteral("Balance")));
    QVERIFY(!rs.isNull(QStringLiteral("Obligo")));
    QVERIFY(!rs.isNull(QStringLiteral("Delivery")));
    QVERIFY(!rs.field(QStringLiteral("City")).toString().isEmpty());
}

void TestDemo::companyDetailsQuery() {
    const QString sql =
        QStringLiteral("SELECT CompanyName, ShortName, VatNum, DeductNum, HiddenAccountsFilter"
                       " FROM CompanyDefenitions WHERE ID = 1");
    Recordset rs;
    rs.Open(sql, connStr());
    QVERIFY(!rs.Eof());
    QCOMPARE(rs.field(QStringLiteral("CompanyName")).toString(),
             QStringLiteral("אופק סחר והפצה בע\"מ"));
    QCOMPARE(rs.field(QStringLiteral("ShortName")).toString(), QStringLiteral("אופק סחר"));
    QCOMPARE(rs.field(QStringLiteral("VatNum")).toString(), QStringLiteral("514276381"));
    QCOMPARE(rs.field(QStringLiteral("DeductNum")).toString(), QStringLiteral("937465120"));
    QCOMPARE(rs.field(QStringLiteral("HiddenAccountsFilter")).toString(), QStringLiteral("PRV"));
    Recordset rs2;
    rs2.Open(sql, connStr(QStringLiteral("demo2.db")));
    QVERIFY(!rs2.Eof());
    QCOMPARE(rs2.field(QStringLiteral("ShortName")).toString(), QStringLiteral("אופק נכסים"));
}

void TestDemo::journalQueries_data() {
    QTest::addColumn<bool>("names");
    QTest::addColumn<bool>("openOnly");
    QTest::newRow("all lines") << false << false;
    QTest::newRow("open lines") << false << true;
    QTest::newRow("all lines with names") << true << false;
    QTest::newRow("open lines with names") << true << true;
}

void TestDemo::journalQueries() {
    QFETCH(bool, names);
    QFETCH(bool, openOnly);
    const QString key = DemoAccountKey();
    const int count = scalar(journalCountSql(key, names, openOnly), connStr()).toInt();
    QVERIFY(count > 0);
    Recordset rs;
    rs.Open(journalSql(key, names, openOnly), connStr(), ardcard::CursorKind::Dynamic);
    rs.MoveFirst();
    int rows = 0;
    for (; !rs.Eof(); rs.MoveNext()) {
        ++rows;
        QCOMPARE(rs.field(QStringLiteral("AccountKey")).toString(), key);
        const int currency = rs.field(QStringLiteral("CurrencyID")).toInt();
        QVERIFY(currency >= 1 && currency <= 5);
        if (openOnly)
            QCOMPARE(rs.field(QStringLiteral("FullMatch")).toInt(), 0);
        if (names) {
            QVERIFY(rs.indexOf(QStringLiteral("CName")) >= 0);
            QVERIFY(rs.indexOf(QStringLiteral("DName")) >= 0);
        } else {
            QCOMPARE(rs.indexOf(QStringLiteral("CName")), -1);
        }
    }
    QCOMPARE(rows, count);
}

void TestDemo::journalNamesJoinDropsMissingCounterAccounts() {
    // Three lines of the demo account name a counter account that is gone.
    const QString key = DemoAccountKey();
    const int all = scalar(journalCountSql(key, false, false), connStr()).toInt();
    const int named = scalar(journalCountSql(key, true, false), connStr()).toInt();
    QCOMPARE(all - named, 3);
    // And a counter account without a name is read with a Null name.
    QCOMPARE(rowCount(journalSql(key, true, false) +
                          QStringLiteral(" And (CAcc.FullName Is Null Or DAcc.FullName Is Null)"),
                      connStr()),
             2);
}

void TestDemo::journalDatesReadAsDates() {
    Recordset rs;
    rs.Open(journalSql(DemoAccountKey(), false, false), connStr());
    QVERIFY(!rs.Eof());
    QCOMPARE(rs.field(QStringLiteral("ValueDate")).typeId(), QMetaType::QDate);
    QCOMPARE(rs.field(QStringLiteral("DueDate")).typeId(), QMetaType::QDate);
    QVERIFY(rs.field(QStringLiteral("ValueDate")).toDate() >= QDate(2019, 1, 1));
}

void TestDemo::demoAccountInBothCompanies() {
    const QString key = DemoAccountKey();
    QVERIFY(scalar(journalCountSql(key, false, false), connStr()).toInt() > 0);
    QVERIFY(
        scalar(journalCountSql(key, false, false), connStr(QStringLiteral("demo2.db"))).toInt() >
        0);
    for (const QString& file : {QStringLiteral("demo.db"), QStringLiteral("demo2.db")}) {
        Recordset rs;
        rs.Open(QStringLiteral("SELECT Filter, Dumi FROM Accounts WHERE AccountKey = '") + key +
                    u'\'',
                connStr(file));
        QVERIFY(!rs.Eof());
        QVERIFY(rs.field(QStringLiteral("Filter"))
                    .toString()
                    .compare(QStringLiteral("PRV"), Qt::CaseInsensitive) != 0);
        QCOMPARE(rs.field(QStringLiteral("Dumi")).toInt(), 0);
    }
}

void TestDemo::connectionCheckQueries() {
    QVERIFY(rowCount(QStringLiteral("SELECT * FROM Accounts"), connStr()) >= 200);
    QCOMPARE(rowCount(QStringLiteral("SELECT DocumentID FROM DocumentsDef WHERE DocumentID = 1"),
                      connStr()),
             1);
}

void TestDemo::itemPageQueries_data() {
    QTest::addColumn<QString>("sql");
    QTest::addColumn<int>("minRows");
    const QString k = QStringLiteral("'P1001'");
    QTest::newRow("item") << QStringLiteral(
                                 "Select Items.ID, Items.ItemKey, Items.ItemName, Items.SortGroup"
                                 ", Items.Filter, Items.ForignName, Items.SalesUnit"
                                 ", Items.Weight, Items.Volume, Items.DefaultWarehouse"
                                 ", Items.Localization, Items.BarCode, Items.Quantity"
                                 ", Items.Price, Items.Currency, Items.ExFile, PurchPrice, "
                                 "PurchCurrency"
                                 " From Items Where Items.ItemKey =") +
                                 k
                          << 1;
    QTest::newRow("notes") << QStringLiteral(
                                  "SELECT ExtraNoteNames.NoteName, ExtraNotes.Note, "
                                  "ExtraNoteNames.NoteID FROM ExtraNoteNames, ExtraNotes"
                                  " WHERE ExtraNoteNames.NoteID = ExtraNotes.NoteID"
                                  " AND ExtraNotes.ItemFlag = 1 AND ExtraNoteNames.ItemFlag = 1"
                                  " AND ExtraNotes.KeF = ") +
                                  k + QStringLiteral(" ORDER BY ExtraNoteNames.NoteName")
                           << 1;
    QTest::newRow("sums") << QStringLiteral(
                                 "SELECT ExtraSumNames.SuFName, ExtraSums.SuF, ExtraSums.SuFID"
                                 " FROM ExtraSumNames, ExtraSums"
                                 " WHERE ExtraSums.SuFID = ExtraSumNames.SuFID"
                                 " AND ExtraSums.ItemFlag = 1 AND ExtraSumNames.ItemFlag = 1"
                                 " AND ExtraSums.KeF = ") +
                                 k + QStringLiteral(" ORDER BY ExtraSumNames.SuFName")
                          << 1;
    QTest::newRow("dates") << QStringLiteral(
                                  "SELECT ExtraDateNames.DatFName, ExtraDates.DatF, "
                                  "ExtraDateNames.DatFID FROM ExtraDateNames, ExtraDates"
                                  " WHERE ExtraDateNames.DatFID = ExtraDates.DatFID"
                                  " AND ExtraDates.ItemFlag = 1 AND ExtraDateNames.ItemFlag = 1"
                                  " AND ExtraDates.KeF = ") +
                                  k +
                                  QStringLiteral(" AND Not ExtraDates.DatF Is Null"
                                                 " ORDER BY ExtraDateNames.DatFName")
                           << 1;
    QTest::newRow("price lists")
        << QStringLiteral("SELECT PL.PriceListNumber, PriceListNames.PriceListName As PriceName"
                          ", PL.Price As LastPrice, PL.CurrencyCode As LastCurrency"
                          " FROM PriceListsLastDateWithSub PL, PriceListNames"
                          " WHERE PriceListNames.PriceListID = PL.PriceListNumber"
                          " AND Not (PL.Price Is Null)"
                          " AND PL.ItemKey = ") +
               k +
               QStringLiteral(" GROUP BY PL.PriceListNumber, PriceListNames.PriceListName, "
                              "PL.Price, PL.CurrencyCode ORDER BY PL.PriceListNumber")
        << 2;
    QTest::newRow("special prices")
        << QStringLiteral("SELECT SpecialPrices.AccountKey, Accounts.FullName, "
                          "SpecialPrices.ValidDate"
                          ", SpecialPricesMoves.Price, SpecialPricesMoves.CurrencyCode"
                          " FROM SpecialPricesMoves, SpecialPrices, Accounts"
                          " WHERE SpecialPricesMoves.SPID = SpecialPrices.ID"
                          " And SpecialPricesMoves.MinQuantity=0"
                          " AND Accounts.AccountKey = SpecialPrices.AccountKey"
                          " AND Not (SpecialPricesMoves.Price Is Null)"
                          " AND SpecialPrices.ItemKey = ") +
               k + QStringLiteral(" ORDER BY SpecialPrices.AccountKey")
        << 1;
    QTest::newRow("alternative keys")
        << QStringLiteral("SELECT AlterKeys.AccountKey, Accounts.FullName, AlterKeys.AlterKey"
                          ", AlterKeys.Def FROM AlterKeys, Accounts"
                          " WHERE Accounts.AccountKey = AlterKeys.AccountKey"
                          " AND Not (AlterKeys.AlterKey Is Null)"
                          " AND AlterKeys.ItemKey = ") +
               k + QStringLiteral(" ORDER BY AlterKeys.AccountKey")
        << 1;
    QTest::newRow("alternative items")
        << QStringLiteral("SELECT AlternativeItems.AlterItem, Items.ItemName"
                          ", AlternativeItems.Priority FROM AlternativeItems, Items"
                          " WHERE Items.ItemKey = AlternativeItems.AlterItem"
                          " AND AlternativeItems.ItemKey = ") +
               k +
               QStringLiteral(
                   " ORDER BY AlternativeItems.AlterItem, AlternativeItems.Priority Desc")
        << 2;
    QTest::newRow("product trees")
        << QStringLiteral("SELECT TreeTypes.TreeTypeName, Trees.Quantity, Items.ItemKey"
                          ", Items.ItemName, Trees.SonQuant, Trees.TreeType"
                          " FROM TreeTypes, Trees, Items WHERE Trees.LeveF = 1"
                          " AND TreeTypes.TreeType = Trees.TreeType"
                          " AND Trees.ParentKey = 'SAL-01'"
                          " AND Items.ItemKey = Trees.ItemKey ORDER BY Trees.ItemKey")
        << 5;
}

void TestDemo::itemPageQueries() {
    QFETCH(QString, sql);
    QFETCH(int, minRows);
    const int rows = rowCount(sql, connStr());
    QVERIFY2(rows >= minRows, qPrintable(QString::number(rows)));
}

void TestDemo::accountPageQueries_data() {
    QTest::addColumn<QString>("sql");
    QTest::addColumn<int>("minRows");
    const QString k = QStringLiteral("'10001'");
    QTest::newRow("account")
        << QStringLiteral(
               "SELECT Accounts.ID, Accounts.AccountKey, Accounts.FullName"
               ", Accounts.Filter, Accounts.SortGroup, Accounts.Agent"
               ", Accounts.Address, Accounts.City, Accounts.Zip, Accounts.Country"
               ", Accounts.Phone, Accounts.Fax, Accounts.WorF, Accounts.ExFile"
               ", Accounts.Details, Accounts.CustomerNote, Accounts.Email"
               ", (Select AccSortNames.SortCodeName From AccSortNames Where "
               "AccSortNames.AccSortCode = Accounts.SortGroup) As SortName"
               ", (Select AWN.Name From AgentWarehouseNames AWN Where AWN.Sort = 1 And AWN.NameID "
               "= Accounts.Agent) As AgentName"
               " From Accounts Where Accounts.AccountKey =") +
               k
        << 1;
    QTest::newRow("notes") << QStringLiteral("SELECT ExtraNoteNames.NoteName, ExtraNotes.Note"
                                             " FROM ExtraNoteNames, ExtraNotes"
                                             " WHERE ExtraNoteNames.NoteID = ExtraNotes.NoteID"
                                             " AND ExtraNotes.ItemFlag = 0 AND "
                                             "ExtraNoteNames.ItemFlag = 0"
                                             " AND ExtraNotes.KeF = ") +
                                  k + QStringLiteral(" ORDER BY ExtraNoteNames.NoteName")
                           << 2;
    QTest::newRow("sums") << QStringLiteral("SELECT ExtraSumNames.SuFName, ExtraSums.SuF"
                                            " FROM ExtraSumNames, ExtraSums"
                                            " WHERE ExtraSums.SuFID = ExtraSumNames.SuFID"
                                            " AND ExtraSums.ItemFlag = 0 AND "
                                            "ExtraSumNames.ItemFlag = 0"
                                            " AND ExtraSums.KeF = ") +
                                 k + QStringLiteral(" ORDER BY ExtraSumNames.SuFName")
                          << 2;
    QTest::newRow("dates") << QStringLiteral("SELECT ExtraDateNames.DatFName, ExtraDates.DatF"
                                             " FROM ExtraDateNames, ExtraDates"
                                             " WHERE ExtraDateNames.DatFID = ExtraDates.DatFID"
                                             " AND ExtraDates.ItemFlag = 0 AND "
                                             "ExtraDateNames.ItemFlag = 0"
                                             " AND ExtraDates.KeF = ") +
                                  k +
                                  QStringLiteral(" AND Not ExtraDates.DatF Is Null"
                                                 " ORDER BY ExtraDateNames.DatFName")
                           << 2;
    QTest::newRow("contacts") << QStringLiteral(
                                     "SELECT CRMContact.CName, CRMContact.CTitle, CRMContact.CMail"
                                     ", CRMContact.CPhone, CRMContact.C2Phone, CRMContact.CCelular"
                                     ", CRMContact.CFax, CRMContact.Branch, CRMContact.Address"
                                     ", CRMContact.Remark, CRMContact.SecRemark"
                                     " FROM CRMContact WHERE CRMContact.AccountKey = ") +
                                     k +
                                     QStringLiteral(" And CRMContact.CStatus = 1"
                                                    " ORDER BY CRMContact.ID")
                              << 2;
    QTest::newRow("alternative keys")
        << QStringLiteral("SELECT AlterKeys.ItemKey, Items.ItemName, AlterKeys.AlterKey"
                          ", AlterKeys.Def FROM AlterKeys, Items"
                          " WHERE Items.ItemKey = AlterKeys.ItemKey"
                          " AND Not (AlterKeys.AlterKey Is Null)"
                          " AND AlterKeys.AccountKey = ") +
               k + QStringLiteral(" ORDER BY AlterKeys.ItemKey")
        << 3;
    QTest::newRow("special prices")
        << QStringLiteral("SELECT SpecialPrices.ItemKey, Items.ItemName, SpecialPrices.ValidDate"
                          ", SpecialPricesMoves.Price, SpecialPricesMoves.CurrencyCode"
                          " FROM SpecialPricesMoves, SpecialPrices, Items"
                          " WHERE SpecialPricesMoves.SPID = SpecialPrices.ID"
                          " And SpecialPricesMoves.MinQuantity=0"
                          " AND Items.ItemKey = SpecialPrices.ItemKey"
                          " AND Not (SpecialPricesMoves.Price Is Null)"
                          " AND SpecialPrices.AccountKey = ") +
               k + QStringLiteral(" ORDER BY SpecialPrices.ItemKey")
        << 4;
}

void TestDemo::accountPageQueries() {
    QFETCH(QString, sql);
    QFETCH(int, minRows);
    const int rows = rowCount(sql, connStr());
    QVERIFY2(rows >= minRows, qPrintable(QString::number(rows)));
}

void TestDemo::documentTypesQuery() {
    Recordset rs;
    rs.Open(QStringLiteral("Select D.DocumentID, D.DocName From DocumentsDef D"
                           " Where D.DocumentID > 0"),
            connStr());
    int rows = 0;
    int nullNames = 0;
    for (; !rs.Eof(); rs.MoveNext()) {
        ++rows;
        QVERIFY(rs.field(QStringLiteral("DocumentID")).toInt() > 0);
        nullNames += rs.isNull(QStringLiteral("DocName")) ? 1 : 0;
    }
    QCOMPARE(rows, 16);
    QCOMPARE(nullNames, 1);
    QCOMPARE(
        scalar(QStringLiteral("SELECT DocName FROM DocumentsDef WHERE DocumentID = 0"), connStr())
            .toString(),
        QStringLiteral("ללא מסמך"));
}

void TestDemo::keysCompareWithoutCase() {
    const QString path = dir_.filePath(QStringLiteral("case.db"));
    CreateCompanyFile(path);
    {
        CompanyWriter writer(path);
        writer.insert(QStringLiteral("Accounts"),
                      {{QStringLiteral("ID"), 1},
                       {QStringLiteral("AccountKey"), QStringLiteral("ABC")},
                       {QStringLiteral("FullName"), QStringLiteral("חשבון באותיות")}});
    }
    const QString conn = connStr(QStringLiteral("case.db"));
    QCOMPARE(
        scalar(QStringLiteral("SELECT AccountKey FROM Accounts WHERE AccountKey = 'abc'"), conn)
            .toString(),
        QStringLiteral("ABC"));
    QCOMPARE(scalar(QStringLiteral("SELECT Min(ID) As StartID FROM Accounts WHERE Dumi = 0"
                                   " And AccountKey = 'aBc'"),
                    conn)
                 .toInt(),
             1);
}

void TestDemo::writerWritesNullAndCommitsOnDestruction() {
    const QString path = dir_.filePath(QStringLiteral("writer.db"));
    CreateCompanyFile(path);
    {
        CompanyWriter writer(path);
        writer.insert(QStringLiteral("Accounts"),
                      {{QStringLiteral("ID"), 7},
                       {QStringLiteral("AccountKey"), QStringLiteral("K7")},
                       {QStringLiteral("FullName"), QVariant()},
                       {QStringLiteral("Balance"), 1234.5}});
        writer.exec(QStringLiteral("UPDATE Accounts SET Phone = '03-1234567' WHERE ID = 7"));
    }
    Recordset rs;
    rs.Open(QStringLiteral("SELECT * FROM Accounts"), connStr(QStringLiteral("writer.db")));
    QVERIFY(!rs.Eof());
    QCOMPARE(rs.field(QStringLiteral("AccountKey")).toString(), QStringLiteral("K7"));
    QVERIFY(rs.isNull(QStringLiteral("FullName")));
    QCOMPARE(rs.field(QStringLiteral("Balance")).toDouble(), 1234.5);
    QCOMPARE(rs.field(QStringLiteral("Phone")).toString(), QStringLiteral("03-1234567"));
    QCOMPARE(rs.field(QStringLiteral("Dumi")).toInt(), 0); // the default
    rs.MoveNext();
    QVERIFY(rs.Eof());
}

void TestDemo::writerFailsWithDriverText() {
    const QString path = dir_.filePath(QStringLiteral("failing.db"));
    CreateCompanyFile(path);
    CompanyWriter writer(path);
    try {
        writer.insert(QStringLiteral("NoSuchTable"), {{QStringLiteral("ID"), 1}});
        QFAIL("no failure");
    } catch (const Failure& failure) {
        QVERIFY2(failure.description().contains(QStringLiteral("no such table")), failure.what());
    }
    QVERIFY_THROWS_EXCEPTION(Failure, writer.exec(QStringLiteral("SELEC 1")));
}

void TestDemo::writerRefusesMissingFile() {
    const QString path = dir_.filePath(QStringLiteral("missing.db"));
    QVERIFY_THROWS_EXCEPTION(Failure, CompanyWriter{path});
    QVERIFY(!QFileInfo::exists(path));
}

void TestDemo::createReplacesExistingFile() {
    const QString path = dir_.filePath(QStringLiteral("replaced.db"));
    CreateCompanyFile(path);
    {
        CompanyWriter writer(path);
        writer.insert(
            QStringLiteral("Accounts"),
            {{QStringLiteral("ID"), 1}, {QStringLiteral("AccountKey"), QStringLiteral("OLD")}});
    }
    CreateCompanyFile(path);
    QCOMPARE(
        rowCount(QStringLiteral("SELECT * FROM Accounts"), connStr(QStringLiteral("replaced.db"))),
        0);
}

void TestDemo::ledgerCompanyHasExactLineCount() {
    const QString path = dir_.filePath(QStringLiteral("ledger.db"));
    BuildLedgerCompany(path, QStringLiteral("Acc-1000"), 1000);
    const QString conn = connStr(QStringLiteral("ledger.db"));
    QCOMPARE(scalar(journalCountSql(QStringLiteral("Acc-1000"), false, false), conn).toInt(), 1000);
    QCOMPARE(scalar(journalCountSql(QStringLiteral("ACC-1000"), true, false), conn).toInt(), 1000);
    QCOMPARE(rowCount(journalSql(QStringLiteral("Acc-1000"), true, false), conn), 1000);
    const int open = scalar(journalCountSql(QStringLiteral("Acc-1000"), false, true), conn).toInt();
    QVERIFY(open > 0 && open < 1000);
    QCOMPARE(scalar(QStringLiteral("SELECT Count(*) FROM Accounts"), conn).toInt(), 5);
    QCOMPARE(
        scalar(QStringLiteral("SELECT Max(ValueDate) FROM JurnalTrans"), conn).toString().left(4),
        QStringLiteral("2025"));
}

void TestDemo::buildsAreDeterministic() {
    QTemporaryDir again;
    QVERIFY(again.isValid());
    BuildDemoCompany(again.path());
    for (const QString& file : {QStringLiteral("demo.db"), QStringLiteral("demo2.db")}) {
        const QByteArray first = contentDigest(connStr(file));
        const QByteArray second =
            contentDigest(BuildConnString(again.path(), QString(), QString(), file, 4));
        QCOMPARE(second, first);
    }
}

QTEST_GUILESS_MAIN(TestDemo)
#include "test_demo.moc"
