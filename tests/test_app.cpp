// The host application end to end: the built `ardcard` run headless on a
// fixture company, driven by the scripts in tests/scripts/.

#include "demo/company_writer.h"

#include <QProcess>
#include <QTemporaryDir>
#include <QTest>

using namespace ardcard;

namespace {

struct Run {
    int code = -1;
    QString out;
    QString err;
};

} // namespace

class TestApp : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void lookup_showsTheAccountThePageNamed();
    void fetch_sortsByTheClickedHeader();
    void navigation_stepsThroughTheAccounts();
    void failure_isAMessageLineOnStderr();
    void throwingScript_exitsWithOneAndTheError();
    void badArguments_exitWithTwo_data();
    void badArguments_exitWithTwo();

private:
    Run ardcard(const QStringList& args);
    QStringList fixturePage() const;
    static QString script(const char* name) {
        return QStringLiteral(ARDCARD_SCRIPTS_DIR "/") + QLatin1String(name);
    }

    QTemporaryDir dir_;
};

void TestApp::initTestCase() {
    QVERIFY(dir_.isValid());
    QDir(dir_.path()).mkpath(QStringLiteral("tmp"));
    QDir(dir_.path()).mkpath(QStringLiteral("config"));
    QDir(dir_.path()).mkpath(QStringLiteral("data"));
    const QString file = dir_.filePath(QStringLiteral("fixture.db"));
    demo::CreateCompanyFile(file);
    demo::CompanyWriter w(file);
    auto account = [&](int id, const char* key, const QString& name, const char* phone,
                       const QString& city) {
        w.insert(QStringLiteral("Accounts"), {{QStringLiteral("ID"), id},
                                              {QStringLiteral("AccountKey"), QLatin1String(key)},
                                              {QStringLiteral("FullName"), name},
                                              {QStringLiteral("Phone"), QLatin1String(phone)},
                                              {QStringLiteral("City"), city},
                                              {QStringLiteral("Balance"), 0.0},
                                              {QStringLiteral("Dumi"), 0}});
    };
    account(1, "1001", QStringLiteral("מאפיית השחר"), "03-5550001", QStringLiteral("חיפה"));
    account(2, "1002", QStringLiteral("נגריית הגליל"), "04-5550002", QStringLiteral("עכו"));
    account(3, "1003", QStringLiteral("דפוס אור"), "08-5550003", QStringLiteral("אילת"));
    // Three journal lines of 1001, transactions 10, 9 and 2.
    w.insert(QStringLiteral("Currencies"),
             {{QStringLiteral("CurrencyCode"), QStringLiteral("שח")}, {QStringLiteral("ID"), 1}});
    auto line = [&](int transId, const char* date, double amount) {
        w.insert(QStringLiteral("JurnalTrans"),
                 {{QStringLiteral("TransID"), transId},
                  {QStringLiteral("Type"), 0},
                  {QStringLiteral("Status"), 1},
                  {QStringLiteral("FixedID"), 0},
                  {QStringLiteral("ValueDate"), QLatin1String(date)},
                  {QStringLiteral("DueDate"), QLatin1String(date)},
                  {QStringLiteral("BatchNo"), 7},
                  {QStringLiteral("Description"), QStringLiteral("חשבונית")},
                  {QStringLiteral("CurrencyCode"), QStringLiteral("שח")},
                  {QStringLiteral("TransDebID"), QStringLiteral("4000")},
                  {QStringLiteral("TransCredID"), QStringLiteral("1001")}});
        w.insert(QStringLiteral("JurnalTransMoves"),
                 {{QStringLiteral("TransID"), transId},
                  {QStringLiteral("AccountKey"), QStringLiteral("1001")},
                  {QStringLiteral("SuF"), amount},
                  {QStringLiteral("SuFDlr"), 0.0},
                  {QStringLiteral("DebitCredit"), 0},
                  {QStringLiteral("FullMatch"), 0}});
    };
    line(10, "2024-01-05", 100);
    line(9, "2024-01-06", 50);
    line(2, "2024-01-07", 25);
    w.commit();
}

QStringList TestApp::fixturePage() const {
    return {QStringLiteral("--set"), QStringLiteral("AServer=") + dir_.path(),
            QStringLiteral("--set"), QStringLiteral("AConnType=4"),
            QStringLiteral("--set"), QStringLiteral("ADatabase=fixture.db")};
}

Run TestApp::ardcard(const QStringList& args) {
    QProcess process;
    QProcessEnvironment env = QProcessEnvironment::systemEnvironment();
    env.insert(QStringLiteral("TMPDIR"), dir_.filePath(QStringLiteral("tmp")));
    env.insert(QStringLiteral("XDG_CONFIG_HOME"), dir_.filePath(QStringLiteral("config")));
    env.insert(QStringLiteral("XDG_DATA_HOME"), dir_.filePath(QStringLiteral("data")));
    process.setProcessEnvironment(env);
    process.start(QStringLiteral(ARDCARD_BIN), args);
    Run run;
    if (!process.waitForFinished(120000)) {
        process.kill();
        process.waitForFinished();
        run.err = QStringLiteral("did not finish");
        return run;
    }
    run.code = process.exitStatus() == QProcess::NormalExit ? process.exitCode() : -2;
    run.out = QString::fromUtf8(process.readAllStandardOutput());
    run.err = QString::fromUtf8(process.readAllStandardError());
    return run;
}

void TestApp::lookup_showsTheAccountThePageNamed() {
    const Run run = ardcard(QStringList{QStringLiteral("--headless"), QStringLiteral("--script"),
                                        script("lookup.js"), QStringLiteral("--set"),
                                        QStringLiteral("AAccount=1002")} +
                            fixturePage());
    QVERIFY2(run.code == 0, qPrintable(run.err));
    const QString expected = QStringLiteral("key: 1002\n"
                                            "name: נגריית הגליל\n"
                                            "phone: 04-5550002\n"
                                            "city: עכו\n"
                                            "location: 2\n"
                                            "rows: 2 columns: 17\n"
                                            "header: שורה\n"
                                            "conn: 4 fixture.db\n"
                                            "messages: 0\n");
    QCOMPARE(run.out, expected);
}

void TestApp::fetch_sortsByTheClickedHeader() {
    const Run run = ardcard(QStringList{QStringLiteral("--headless"), QStringLiteral("--script"),
                                        script("fetch_sort.js")} +
                            fixturePage());
    QVERIFY2(run.code == 0, qPrintable(run.err));
    const QString expected = QStringLiteral("found: 1002 AccountName\n"
                                            "rows: 5 print enabled: true\n"
                                            "by transaction: 2=25.00 9=50.00 10=100.00\n"
                                            "still: 2 9 10\n"
                                            "windows: 1 1\n");
    QCOMPARE(run.out, expected);
    QVERIFY2(run.err.contains(QStringLiteral("navigate: 1: ")), qPrintable(run.err));
}

void TestApp::navigation_stepsThroughTheAccounts() {
    const Run run = ardcard(QStringList{QStringLiteral("--headless"), QStringLiteral("--script"),
                                        script("navigate.js")} +
                            fixturePage());
    QVERIFY2(run.code == 0, qPrintable(run.err));
    const QString expected = QStringLiteral("last: 1003 דפוס אור\n"
                                            "first: 1001 מאפיית השחר\n"
                                            "next: 1002\n"
                                            "print enabled: false\n"
                                            "typed key: '10,02'\n"
                                            "caught: שימוש לא חוקי בערך ריק\n");
    QCOMPARE(run.out, expected);
}

void TestApp::failure_isAMessageLineOnStderr() {
    const Run run = ardcard(QStringList{QStringLiteral("--headless"), QStringLiteral("--script"),
                                        script("missing_db.js")} +
                            fixturePage());
    QVERIFY2(run.code == 0, qPrintable(run.err));
    // The lookup's message, then the fetch's own for the same missing file.
    QCOMPARE(run.out, QStringLiteral("messages: 2 critical תקלה בקריאת החשבונות\n"
                                     "after clear: 0\n"));
    QVERIFY2(run.err.contains(QStringLiteral("message: information: תקלה: ")), qPrintable(run.err));
    QVERIFY2(run.err.contains(QStringLiteral("message: critical: תקלה בקריאת החשבונות: ")),
             qPrintable(run.err));
}

void TestApp::throwingScript_exitsWithOneAndTheError() {
    const Run run = ardcard(
        QStringList{QStringLiteral("--headless"), QStringLiteral("--script"), script("throws.js")} +
        fixturePage());
    QCOMPARE(run.code, 1);
    QCOMPARE(run.out, QStringLiteral("before\n"));
    QVERIFY2(run.err.contains(QStringLiteral("נכשל בכוונה")), qPrintable(run.err));
    QVERIFY2(run.err.contains(QStringLiteral("throws.js:2")), qPrintable(run.err));
}

void TestApp::badArguments_exitWithTwo_data() {
    QTest::addColumn<QStringList>("args");
    QTest::newRow("unknown option") << QStringList{QStringLiteral("--frobnicate")};
    QTest::newRow("set without =") << QStringList{
        QStringLiteral("--headless"), QStringLiteral("--set"), QStringLiteral("AServer")};
    QTest::newRow("missing script file")
        << QStringList{QStringLiteral("--headless"), QStringLiteral("--script"),
                       QStringLiteral("/nonexistent/nothing.js")};
    QTest::newRow("option without its value") << QStringList{QStringLiteral("--address")};
    QTest::newRow("stray word") << QStringList{QStringLiteral("card")};
}

void TestApp::badArguments_exitWithTwo() {
    QFETCH(QStringList, args);
    const Run run = ardcard(args);
    QCOMPARE(run.code, 2);
    QVERIFY(run.err.contains(QStringLiteral("usage: ardcard")));
    QCOMPARE(run.out, QString());
}

QTEST_MAIN(TestApp)
#include "test_app.moc"
