// Connection strings, the settings store and the data layer, against real
// SQLite files and through the real unixODBC driver manager.
#include "common/failure.h"
#include "common/module_state.h"
#include "connection/conn_string.h"
#include "connection/database.h"
#include "connection/driver_target.h"
#include "connection/settings_store.h"

#include <QCheckBox>
#include <QComboBox>
#include <QFile>
#include <QLineEdit>
#include <QSettings>
#include <QSqlDatabase>
#include <QSqlQuery>
#include <QTemporaryDir>
#include <QtTest>

using namespace ardcard;

class TestConnection : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void initTestCase();
    void init();
    void connString_data();
    void connString();
    void connStringNullPassword();
    void mapping_data();
    void mapping();
    void emptyStringFails();
    void defaultsOfEmptyStore();
    void connTypeStoredValues_data();
    void connTypeStoredValues();
    void garbageSettingsFile();
    void settingsFileIsPrivate();
    void handWrittenCommaList();
    void regControlRoundTrip();
    void regControlBadNumbers();
    void saveFailsWhenStoreIsReadOnly();
    void sqliteBoundAndByString();
    void sqliteNullsDatesAndCase();
    void sqliteIsReadOnly();
    void badQueryDescription();
    void missingFileDescription();
    void corruptFile();
    void moveFirstRewinds();
    void odbcDriverString();

private:
    QString makeCompany(const QString& name);
    QTemporaryDir dir_;
    QTemporaryDir config_;
};

void TestConnection::initTestCase() {
    QVERIFY(dir_.isValid());
    qputenv("XDG_CONFIG_HOME", config_.path().toUtf8());
    QStandardPaths::setTestModeEnabled(false);
}

void TestConnection::init() {
    QFile::remove(config_.filePath(QStringLiteral("VL7Trans.ini")));
    moduleState().conn = ConnValues{};
}

QString TestConnection::makeCompany(const QString& name) {
    const QString path = dir_.filePath(name);
    QFile::remove(path);
    {
        QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), QStringLiteral("w"));
        db.setDatabaseName(path);
        if (!db.open())
            return {};
        QSqlQuery q(db);
        q.exec(QStringLiteral("CREATE TABLE Accounts (ID INTEGER PRIMARY KEY, AccountKey TEXT "
                              "COLLATE NOCASE, FullName TEXT, Balance REAL, Opened DATE)"));
        q.exec(QStringLiteral("INSERT INTO Accounts VALUES (1, 'A1', 'אבי', 12.5, '2024-03-01')"));
        q.exec(QStringLiteral("INSERT INTO Accounts VALUES (2, 'B2', NULL, NULL, NULL)"));
        q.exec(QStringLiteral("INSERT INTO Accounts VALUES (3, 'C3', 'גד', -1, '1900-01-01')"));
        db.close();
    }
    QSqlDatabase::removeDatabase(QStringLiteral("w"));
    return path;
}

void TestConnection::connString_data() {
    QTest::addColumn<QString>("server");
    QTest::addColumn<QString>("uid");
    QTest::addColumn<QString>("pwd");
    QTest::addColumn<QString>("database");
    QTest::addColumn<int>("type");
    QTest::addColumn<QString>("expected");
    QTest::newRow("1 odbc") << "srv"
                            << "sa"
                            << "pw"
                            << "db" << 1
                            << "driver={SQL Server};server=srv;uid=sa;pwd=pw;database=db";
    QTest::newRow("2 integrated security even with a password")
        << "srv"
        << ""
        << "pw"
        << "db" << 2
        << "Provider=sqloledb;Data Source=srv;Integrated Security=SSPI;Persist Security "
           "Info=False;Initial Catalog=db";
    QTest::newRow("2 user") << "srv"
                            << "u"
                            << "p"
                            << "db" << 2
                            << "Provider=sqloledb;Data Source=srv;User Id=u;Password=p;Initial "
                               "Catalog=db";
    QTest::newRow("3 dir without backslash") << "C:\\data"
                                             << "u"
                                             << "p"
                                             << "f.mdb" << 3
                                             << "Provider=Microsoft.Jet.OLEDB.3.51;Data "
                                                "Source=C:\\data\\f.mdb";
    QTest::newRow("4 dir with backslash") << "C:\\data\\"
                                          << ""
                                          << ""
                                          << "f.mdb" << 4
                                          << "Provider=Microsoft.Jet.OLEDB.4.0;Data "
                                             "Source=C:\\data\\f.mdb";
    QTest::newRow("4 empty server")
        << ""
        << ""
        << ""
        << "f.mdb" << 4 << "Provider=Microsoft.Jet.OLEDB.4.0;Data Source=f.mdb";
    QTest::newRow("5 dsn ignores server") << "srv"
                                          << "u"
                                          << "p"
                                          << "MyDsn" << 5 << "DSN=MyDsn;uid=u;pwd=p";
    QTest::newRow("6 access odbc") << "D:\\x"
                                   << "u"
                                   << "p"
                                   << "a.mdb" << 6
                                   << "driver={Microsoft Access Driver (*.mdb)};Dbq=D:\\x\\a.mdb;"
                                      "uid=u;pwd=p";
    QTest::newRow("6 empty server") << ""
                                    << ""
                                    << ""
                                    << "a.mdb" << 6
                                    << "driver={Microsoft Access Driver (*.mdb)};Dbq=a.mdb;uid=;"
                                       "pwd=";
    QTest::newRow("0 none") << "srv"
                            << "u"
                            << "p"
                            << "db" << 0 << "";
    QTest::newRow("7 none") << "srv"
                            << "u"
                            << "p"
                            << "db" << 7 << "";
    QTest::newRow("password with semicolon unchanged")
        << "srv"
        << "sa"
        << "a;b"
        << "db" << 1 << "driver={SQL Server};server=srv;uid=sa;pwd=a;b;database=db";
    QTest::newRow("nothing trimmed")
        << " s "
        << " u "
        << " p "
        << " d " << 1 << "driver={SQL Server};server= s ;uid= u ;pwd= p ;database= d ";
}

void TestConnection::connString() {
    QFETCH(QString, server);
    QFETCH(QString, uid);
    QFETCH(QString, pwd);
    QFETCH(QString, database);
    QFETCH(int, type);
    QFETCH(QString, expected);
    QCOMPARE(BuildConnString(server, uid, pwd, database, type), expected);
}

void TestConnection::connStringNullPassword() {
    QCOMPARE(BuildConnString(QStringLiteral("s"), QStringLiteral("u"), QVariant(),
                             QStringLiteral("d"), 1),
             QStringLiteral("driver={SQL Server};server=s;uid=u;pwd=;database=d"));
}

void TestConnection::mapping_data() {
    QTest::addColumn<QString>("connStr");
    QTest::addColumn<QString>("driver");
    QTest::addColumn<QString>("databaseName");
    const QString odbc = QStringLiteral("driver={SQL Server};server=s;uid=u;pwd=p;database=d");
    QTest::newRow("odbc unchanged") << odbc << "QODBC" << odbc;
    QTest::newRow("dsn unchanged") << "DSN=x;uid=u;pwd=p"
                                   << "QODBC"
                                   << "DSN=x;uid=u;pwd=p";
    QTest::newRow("sqloledb user")
        << "Provider=sqloledb;Data Source=s;User Id=u;Password=p;Initial "
           "Catalog=d"
        << "QODBC" << odbc;
    QTest::newRow("sqloledb integrated")
        << "Provider=sqloledb;Data Source=s;Integrated Security=SSPI;Persist Security "
           "Info=False;Initial Catalog=d"
        << "QODBC"
        << "driver={SQL Server};server=s;Trusted_Connection=yes;database=d";
}

void TestConnection::mapping() {
    QFETCH(QString, connStr);
    QFETCH(QString, driver);
    QFETCH(QString, databaseName);
    const DriverTarget t = MapConnString(connStr, 60);
    QCOMPARE(t.driver, driver);
    QCOMPARE(t.databaseName, databaseName);
    QVERIFY(t.options.contains(QStringLiteral("SQL_ATTR_LOGIN_TIMEOUT=60")));
}

void TestConnection::emptyStringFails() {
    Connection c;
    try {
        c.open(BuildConnString(QStringLiteral("s"), QString(), QString(), QStringLiteral("d"), 0));
        QFAIL("an empty connection string opened");
    } catch (const Failure& f) {
        QVERIFY(!f.description().isEmpty());
    }
}

void TestConnection::defaultsOfEmptyStore() {
    ReadConnParams();
    const ConnValues& c = moduleState().conn;
    QCOMPARE(c.ConnServer, QStringLiteral("server"));
    QCOMPARE(c.ConnUID, QStringLiteral("sa"));
    QCOMPARE(c.ConnPWD, QString());
    QCOMPARE(c.ConnDataBase, QStringLiteral("velmor02"));
    QCOMPARE(c.ConnType, 1);
    QCOMPARE(BuildConnString(c.ConnServer, c.ConnUID, c.ConnPWD, c.ConnDataBase, c.ConnType),
             QStringLiteral("driver={SQL Server};server=server;uid=sa;pwd=;database=velmor02"));
}

void TestConnection::connTypeStoredValues_data() {
    QTest::addColumn<QByteArray>("stored");
    QTest::addColumn<int>("type");
    QTest::newRow("position 3 is type 4") << QByteArray("3") << 4;
    QTest::newRow("position -1 is type 0") << QByteArray("-1") << 0;
    QTest::newRow("position 9 is type 10") << QByteArray("9") << 10;
    QTest::newRow("not a number keeps the type") << QByteArray("abc") << 6;
    QTest::newRow("empty keeps the type") << QByteArray("") << 6;
    QTest::newRow("fraction rounds") << QByteArray("1.6") << 3;
}

void TestConnection::connTypeStoredValues() {
    QFETCH(QByteArray, stored);
    QFETCH(int, type);
    QFile f(config_.filePath(QStringLiteral("VL7Trans.ini")));
    QVERIFY(f.open(QIODevice::WriteOnly));
    f.write("[Params]\r\nConnServer=C:\\srv\r\nConnType=" + stored + "\r\n");
    f.close();
    moduleState().conn.ConnType = 6;
    ReadConnParams();
    QCOMPARE(moduleState().conn.ConnType, type);
    QCOMPARE(moduleState().conn.ConnServer, QStringLiteral("C:\\srv"));
}

void TestConnection::garbageSettingsFile() {
    QFile f(config_.filePath(QStringLiteral("VL7Trans.ini")));
    QVERIFY(f.open(QIODevice::WriteOnly));
    f.write(QByteArray("\x00\xff[[[=\n\x01garbage", 16));
    f.close();
    ReadConnParams();
    QCOMPARE(moduleState().conn.ConnDataBase, QStringLiteral("velmor02"));
    QCOMPARE(
        ReadSetting(kRegApp, kRegSection, QStringLiteral("CompanyDir"), QStringLiteral("demo.mdb")),
        QStringLiteral("demo.mdb"));
}

void TestConnection::settingsFileIsPrivate() {
    SaveSetting(kRegApp, kRegSection, QStringLiteral("ConnPWD"), QStringLiteral("secret"));
    const QString path = config_.filePath(QStringLiteral("VL7Trans.ini"));
    QVERIFY(QFile::exists(path));
    QCOMPARE(QFile::permissions(path) &
                 (QFile::ReadGroup | QFile::ReadOther | QFile::WriteGroup | QFile::WriteOther),
             QFile::Permissions());
    QCOMPARE(ReadSetting(kRegApp, kRegSection, QStringLiteral("ConnPWD"), QString()),
             QStringLiteral("secret"));
}

void TestConnection::handWrittenCommaList() {
    QFile f(config_.filePath(QStringLiteral("VL7Trans.ini")));
    QVERIFY(f.open(QIODevice::WriteOnly));
    f.write("[Params]\nCompanyDir=a.db,b.db\nConnDataBase=x;y\n");
    f.close();
    QCOMPARE(ReadSetting(kRegApp, kRegSection, QStringLiteral("CompanyDir"), QString()),
             QStringLiteral("a.db,b.db"));
    QCOMPARE(ReadSetting(kRegApp, kRegSection, QStringLiteral("ConnDataBase"), QString()),
             QStringLiteral("x;y"));
    // saving one key keeps the hand-written others as they stand
    SaveSetting(kRegApp, kRegSection, QStringLiteral("CompanyDir"), QStringLiteral("c,d;e"));
    SaveSetting(kRegApp, kRegSection, QStringLiteral("Blank"), QStringLiteral(" padded "));
    QCOMPARE(ReadSetting(kRegApp, kRegSection, QStringLiteral("CompanyDir"), QString()),
             QStringLiteral("c,d;e"));
    QCOMPARE(ReadSetting(kRegApp, kRegSection, QStringLiteral("ConnDataBase"), QString()),
             QStringLiteral("x;y"));
    QCOMPARE(ReadSetting(kRegApp, kRegSection, QStringLiteral("blank"), QString()),
             QStringLiteral(" padded "));
    QFile back(config_.filePath(QStringLiteral("VL7Trans.ini")));
    QVERIFY(back.open(QIODevice::ReadOnly));
    QCOMPARE(back.readAll(), QByteArray("[Params]\nCompanyDir=c,d;e\nConnDataBase=x;y\n"
                                        "Blank=\" padded \"\n"));
}

void TestConnection::regControlRoundTrip() {
    QLineEdit text;
    QComboBox combo;
    combo.addItems(
        {QStringLiteral("a"), QStringLiteral("b"), QStringLiteral("c"), QStringLiteral("d")});
    QCheckBox check;
    text.setText(QStringLiteral("חברה.db"));
    combo.setCurrentIndex(3);
    check.setChecked(true);
    SetGetRegControl(RegSave, kRegApp, kRegSection, QStringLiteral("T"), &text, RegText, {});
    SetGetRegControl(RegSave, kRegApp, kRegSection, QStringLiteral("L"), &combo, RegListIndex, {});
    SetGetRegControl(RegSave, kRegApp, kRegSection, QStringLiteral("V"), &check, RegValue, {});
    QCOMPARE(ReadSetting(kRegApp, kRegSection, QStringLiteral("L"), QString()),
             QStringLiteral("3"));
    QCOMPARE(ReadSetting(kRegApp, kRegSection, QStringLiteral("V"), QString()),
             QStringLiteral("1"));

    text.clear();
    combo.setCurrentIndex(0);
    check.setChecked(false);
    SetGetRegControl(RegLoad, kRegApp, kRegSection, QStringLiteral("T"), &text, RegText, {});
    SetGetRegControl(RegLoad, kRegApp, kRegSection, QStringLiteral("L"), &combo, RegListIndex, 0);
    SetGetRegControl(RegLoad, kRegApp, kRegSection, QStringLiteral("V"), &check, RegValue, 0);
    QCOMPARE(text.text(), QStringLiteral("חברה.db"));
    QCOMPARE(combo.currentIndex(), 3);
    QVERIFY(check.isChecked());

    // a missing key loads the default; an unknown action or kind does nothing
    SetGetRegControl(RegLoad, kRegApp, kRegSection, QStringLiteral("none"), &text, RegText,
                     QStringLiteral("demo.mdb"));
    QCOMPARE(text.text(), QStringLiteral("demo.mdb"));
    SetGetRegControl(3, kRegApp, kRegSection, QStringLiteral("T"), &text, RegText, {});
    SetGetRegControl(RegLoad, kRegApp, kRegSection, QStringLiteral("T"), &text, 4, {});
    QCOMPARE(text.text(), QStringLiteral("demo.mdb"));
}

void TestConnection::regControlBadNumbers() {
    QComboBox combo;
    combo.addItems({QStringLiteral("a"), QStringLiteral("b")});
    combo.setCurrentIndex(1);
    QCheckBox check;
    check.setChecked(true);
    SaveSetting(kRegApp, kRegSection, QStringLiteral("L"), QStringLiteral("7"));
    SaveSetting(kRegApp, kRegSection, QStringLiteral("V"), QStringLiteral("yes"));
    SetGetRegControl(RegLoad, kRegApp, kRegSection, QStringLiteral("L"), &combo, RegListIndex, 0);
    SetGetRegControl(RegLoad, kRegApp, kRegSection, QStringLiteral("V"), &check, RegValue, 0);
    QCOMPARE(combo.currentIndex(), 1);
    QVERIFY(check.isChecked());
    SaveSetting(kRegApp, kRegSection, QStringLiteral("L"), QStringLiteral("-1"));
    SetGetRegControl(RegLoad, kRegApp, kRegSection, QStringLiteral("L"), &combo, RegListIndex, 0);
    QCOMPARE(combo.currentIndex(), -1);
}

void TestConnection::saveFailsWhenStoreIsReadOnly() {
    // A directory where the file should be: not writable even for root.
    const QString path = config_.filePath(QStringLiteral("VL7Trans.ini"));
    QVERIFY(QDir().mkpath(path));
    bool failed = false;
    try {
        SaveSetting(kRegApp, kRegSection, QStringLiteral("X"), QStringLiteral("2"));
    } catch (const Failure& f) {
        failed = f.description().contains(path);
    }
    QDir(path).removeRecursively();
    QVERIFY(failed);
    // and reading such a store gives the defaults
    ReadConnParams();
    QCOMPARE(moduleState().conn.ConnUID, QStringLiteral("sa"));
}

void TestConnection::sqliteBoundAndByString() {
    makeCompany(QStringLiteral("co.db"));
    const QString connStr =
        BuildConnString(dir_.path(), QString(), QString(), QStringLiteral("co.db"), 4);
    Connection c;
    c.setTimeout(60);
    c.open(connStr);
    QVERIFY(c.isSqlite());
    Recordset bound(c);
    bound.Open(QStringLiteral("SELECT Count(ID) As RecCount FROM Accounts"));
    QVERIFY(!bound.Eof());
    QCOMPARE(bound.field(QStringLiteral("RecCount")).toInt(), 3);
    bound.Close();

    Recordset own;
    own.Open(QStringLiteral("SELECT ID FROM Accounts WHERE ID > 5"), connStr);
    QVERIFY(own.Bof() && own.Eof());
    own.Close();
    // and through the Access ODBC form of a local SQLite file
    own.Open(
        QStringLiteral("SELECT ID FROM Accounts ORDER BY ID"),
        BuildConnString(dir_.path(), QStringLiteral("u"), QString(), QStringLiteral("co.db"), 6));
    QCOMPARE(own.field(QStringLiteral("ID")).toInt(), 1);
    own.MoveNext();
    own.MoveNext();
    QCOMPARE(own.field(QStringLiteral("ID")).toInt(), 3);
    own.MoveNext();
    QVERIFY(own.Eof() && !own.Bof());
}

void TestConnection::sqliteNullsDatesAndCase() {
    makeCompany(QStringLiteral("co.db"));
    Recordset rs;
    rs.Open(QStringLiteral("SELECT AccountKey, FullName, Balance, Opened FROM Accounts "
                           "WHERE AccountKey = 'b2' OR AccountKey = 'a1' ORDER BY ID"),
            BuildConnString(dir_.path(), QString(), QString(), QStringLiteral("co.db"), 4));
    QCOMPARE(rs.field(QStringLiteral("accountkey")).toString(), QStringLiteral("A1"));
    QCOMPARE(rs.field(QStringLiteral("FULLNAME")).toString(), QStringLiteral("אבי"));
    QCOMPARE(rs.field(QStringLiteral("Opened")).typeId(), QMetaType::QDate);
    QCOMPARE(rs.field(QStringLiteral("Opened")).toDate(), QDate(2024, 3, 1));
    rs.MoveNext();
    QCOMPARE(rs.field(QStringLiteral("AccountKey")).toString(), QStringLiteral("B2"));
    QVERIFY(rs.isNull(QStringLiteral("FullName")));
    QVERIFY(rs.isNull(QStringLiteral("Balance")));
    QVERIFY(rs.isNull(QStringLiteral("Opened")));
    QVERIFY_THROWS_EXCEPTION(Failure, rs.field(QStringLiteral("NoSuchColumn")));
}

void TestConnection::sqliteIsReadOnly() {
    const QString path = makeCompany(QStringLiteral("co.db"));
    Connection c;
    c.open(BuildConnString(dir_.path(), QString(), QString(), QStringLiteral("co.db"), 4));
    Recordset rs(c);
    QVERIFY_THROWS_EXCEPTION(Failure, rs.Open(QStringLiteral("DELETE FROM Accounts")));
    rs.Open(QStringLiteral("SELECT Count(*) As N FROM Accounts"));
    QCOMPARE(rs.field(QStringLiteral("N")).toInt(), 3);
}

void TestConnection::badQueryDescription() {
    makeCompany(QStringLiteral("co.db"));
    Recordset rs;
    try {
        rs.Open(QStringLiteral("SELECT As StartID FROM Accounts WHERE Dumi = 0"),
                BuildConnString(dir_.path(), QString(), QString(), QStringLiteral("co.db"), 4));
        QFAIL("a bad query ran");
    } catch (const Failure& f) {
        QVERIFY2(f.description().contains(QStringLiteral("syntax error")),
                 qPrintable(f.description()));
    }
    try {
        rs.Open(QStringLiteral("SELECT * FROM NoTable"),
                BuildConnString(dir_.path(), QString(), QString(), QStringLiteral("co.db"), 4));
        QFAIL("a missing table was read");
    } catch (const Failure& f) {
        QVERIFY2(f.description().contains(QStringLiteral("NoTable")), qPrintable(f.description()));
    }
}

void TestConnection::missingFileDescription() {
    Connection c;
    try {
        c.open(BuildConnString(dir_.path(), QString(), QString(), QStringLiteral("none.db"), 4));
        QFAIL("a missing file opened");
    } catch (const Failure& f) {
        QVERIFY(f.description().contains(QStringLiteral("none.db")));
    }
}

void TestConnection::corruptFile() {
    const QString path = makeCompany(QStringLiteral("bad.db"));
    QFile f(path);
    QVERIFY(f.open(QIODevice::ReadWrite));
    f.resize(700); // header intact, pages cut
    f.close();
    Recordset rs;
    QVERIFY_THROWS_EXCEPTION(Failure, rs.Open(QStringLiteral("SELECT * FROM Accounts"),
                                              BuildConnString(dir_.path(), QString(), QString(),
                                                              QStringLiteral("bad.db"), 4)));
}

void TestConnection::moveFirstRewinds() {
    makeCompany(QStringLiteral("co.db"));
    Recordset rs;
    rs.Open(QStringLiteral("SELECT ID FROM Accounts ORDER BY ID"),
            BuildConnString(dir_.path(), QString(), QString(), QStringLiteral("co.db"), 4),
            CursorKind::Dynamic);
    rs.MoveFirst();
    QCOMPARE(rs.field(QStringLiteral("ID")).toInt(), 1);
    rs.MoveNext();
    rs.MoveNext();
    rs.MoveFirst();
    QCOMPARE(rs.field(QStringLiteral("ID")).toInt(), 1);
}

void TestConnection::odbcDriverString() {
    if (!QSqlDatabase::isDriverAvailable(QStringLiteral("QODBC")))
        QSKIP("the Qt ODBC driver is not installed");
    const QString path = makeCompany(QStringLiteral("odbc.db"));
    const QString connStr = QStringLiteral("driver={SQLite3};Database=") + path;
    Recordset rs;
    try {
        rs.Open(QStringLiteral("SELECT AccountKey, FullName FROM Accounts ORDER BY ID"), connStr);
    } catch (const Failure& f) {
        QFAIL(
            qPrintable(QStringLiteral("the SQLite ODBC driver did not open: ") + f.description()));
    }
    QCOMPARE(rs.field(QStringLiteral("ACCOUNTKEY")).toString(), QStringLiteral("A1"));
    QCOMPARE(rs.field(QStringLiteral("FullName")).toString(), QStringLiteral("אבי"));
    rs.MoveNext();
    QVERIFY(rs.isNull(QStringLiteral("FullName")));

    // a driver that is not registered names itself in the description
    Recordset missing;
    try {
        missing.Open(QStringLiteral("SELECT 1"), QStringLiteral("driver={No Such Driver};x=y"));
        QFAIL("an unknown ODBC driver opened");
    } catch (const Failure& f) {
        QVERIFY(!f.description().isEmpty());
    }
}

QTEST_MAIN(TestConnection)
#include "test_connection.moc"
