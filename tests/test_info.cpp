// The information pages against real SQLite company files: every page is
// compared byte for byte with a reference page in tests/reference/info/.
//
// The reference pages are kept as UTF-8 text with LF line ends so that they
// read and diff like any text; the test turns each into windows-1255 with
// CR LF before comparing it with the bytes the page builder wrote. When a page
// differs, the page as written is saved (as UTF-8, LF) under
// <build>/tests/info-actual/<name> and the test prints the diff command:
//     diff -u tests/reference/info/<name> build/tests/info-actual/<name>

#include "card/card.h"
#include "common/failure.h"
#include "common/module_state.h"
#include "connection/conn_string.h"
#include "host/message_box.h"
#include "host/page_window.h"
#include "host/seams.h"
#include "info/ard7info.h"
#include "info/doc_types_page.h"
#include "info/info_page_frame.h"

#include <QDir>
#include <QFile>
#include <QLabel>
#include <QLineEdit>
#include <QSqlDatabase>
#include <QSqlError>
#include <QSqlQuery>
#include <QTemporaryDir>
#include <QtTest>
#include <memory>
#include <unicode/ucnv.h>

using namespace ardcard;

namespace {

// The fixture company, kept as SQL beside the reference pages.
QString fixtureSql() {
    QFile f(QStringLiteral(ARDCARD_INFO_REFERENCE_DIR "/company_fixture.sql"));
    if (!f.open(QIODevice::ReadOnly))
        qFatal("fixture SQL missing");
    QString sql = QString::fromUtf8(f.readAll());
    // Comment lines are not statements.
    QStringList lines = sql.split(u'\n');
    lines.removeIf([](const QString& line) { return line.startsWith(QStringLiteral("--")); });
    return lines.join(u'\n');
}

// Runs `sql` (statements separated by ";" at line ends) into a new SQLite file.
void createDatabase(const QString& path, const QString& sql) {
    QFile::remove(path);
    const QString name = QStringLiteral("fixture-") + path;
    {
        QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), name);
        db.setDatabaseName(path);
        QVERIFY2(db.open(), qPrintable(db.lastError().text()));
        QSqlQuery q(db);
        for (const QString& statement : sql.split(QStringLiteral(";\n"), Qt::SkipEmptyParts)) {
            if (statement.trimmed().isEmpty())
                continue;
            QVERIFY2(q.exec(statement), qPrintable(q.lastError().text() + u'\n' + statement));
        }
        db.close();
    }
    QSqlDatabase::removeDatabase(name);
}

QByteArray fromUnicode(const QString& text) {
    UErrorCode status = U_ZERO_ERROR;
    UConverter* conv = ucnv_open("windows-1255", &status);
    ucnv_setFromUCallBack(conv, UCNV_FROM_U_CALLBACK_STOP, nullptr, nullptr, nullptr, &status);
    QByteArray out(static_cast<qsizetype>(text.size()) * 4 + 16, '\0');
    const int32_t n = ucnv_fromUChars(conv, out.data(), static_cast<int32_t>(out.size()),
                                      reinterpret_cast<const UChar*>(text.utf16()),
                                      static_cast<int32_t>(text.size()), &status);
    ucnv_close(conv);
    if (U_FAILURE(status))
        qFatal("reference text is not windows-1255: %s", u_errorName(status));
    out.resize(n);
    return out;
}

QString toUnicode(const QByteArray& bytes) {
    UErrorCode status = U_ZERO_ERROR;
    UConverter* conv = ucnv_open("windows-1255", &status);
    std::u16string out(static_cast<size_t>(bytes.size()) * 2 + 16, u'\0');
    const int32_t n =
        ucnv_toUChars(conv, reinterpret_cast<UChar*>(out.data()), static_cast<int32_t>(out.size()),
                      bytes.constData(), static_cast<int32_t>(bytes.size()), &status);
    ucnv_close(conv);
    return QString::fromUtf16(out.data(), n);
}

QByteArray readFile(const QString& path) {
    QFile f(path);
    if (!f.open(QIODevice::ReadOnly))
        return {};
    return f.readAll();
}

// The reference page as the bytes a page file holds: windows-1255, CR LF.
QByteArray referenceBytes(const QString& name) {
    const QByteArray utf8 = readFile(QStringLiteral(ARDCARD_INFO_REFERENCE_DIR "/") + name);
    if (utf8.isEmpty())
        return {};
    QString text = QString::fromUtf8(utf8);
    text.replace(u'\n', QStringLiteral("\r\n"));
    return fromUnicode(text);
}

// Byte-for-byte comparison; on a difference the written page is kept for diff.
bool samePage(const QString& pagePath, const QByteArray& expected, const QString& name) {
    const QByteArray actual = readFile(pagePath);
    const QString keep = QStringLiteral(ARDCARD_INFO_ACTUAL_DIR "/") + name;
    if (actual == expected) {
        QFile::remove(keep); // a difference kept from an earlier run is gone
        return true;
    }
    QDir().mkpath(QStringLiteral(ARDCARD_INFO_ACTUAL_DIR));
    QFile f(keep);
    if (f.open(QIODevice::WriteOnly | QIODevice::Truncate))
        f.write(toUnicode(actual).replace(QStringLiteral("\r\n"), QStringLiteral("\n")).toUtf8());
    qWarning("page differs from its reference: diff -u %s/%s %s", ARDCARD_INFO_REFERENCE_DIR,
             qPrintable(name), qPrintable(keep));
    return false;
}

} // namespace

class TestInfo : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void cleanup();

    void keyLiteral_data();
    void keyLiteral();
    void docTypeCode_data();
    void docTypeCode();

    void waitPage();
    void accountPage_data();
    void accountPage();
    void itemPage_data();
    void itemPage();
    void unknownItemGivesEmptyFile();
    void docTypesPage_data();
    void docTypesPage();

    void showAccountSequence();
    void showItemSequence();
    void showInfoSequence();
    void showInfoOtherTypeWritesOnlyWaitPage();
    void failureHalfWayLeavesWindowOnWaitPage();

    void cardKeyImageOpensAccountPage_data();
    void cardKeyImageOpensAccountPage();

    void checkConnection_data();
    void checkConnection();

private:
    QString connString(const QString& file) const {
        return BuildConnString(dataDir_.path(), QString(), QString(), file, 4);
    }
    QString tempFile(const QString& name) const { return tmpDir_.path() + u'/' + name; }

    QTemporaryDir tmpDir_;
    QTemporaryDir dataDir_;
    host::MessageRecorder messages_;
    host::PageWindowRecorder windows_;
    std::unique_ptr<host::ScopedSeams> seams_;
};

void TestInfo::initTestCase() {
    QVERIFY(tmpDir_.isValid());
    QVERIFY(dataDir_.isValid());
    qputenv("TMPDIR", QFile::encodeName(tmpDir_.path()));
    // The card reads and writes its stored options; keep them in the test's own place.
    qputenv("XDG_CONFIG_HOME", QFile::encodeName(dataDir_.path() + QStringLiteral("/config")));
    QCOMPARE(QDir::tempPath(), tmpDir_.path());
    seams_ = std::make_unique<host::ScopedSeams>(&messages_, &windows_);

    const QString dir = dataDir_.path() + u'/';
    createDatabase(dir + QStringLiteral("company.db"), fixtureSql());
    // The same company with no contacts table: the account page fails at it.
    createDatabase(dir + QStringLiteral("no_crm.db"),
                   QString(fixtureSql())
                       .replace(QStringLiteral("CRMContact"), QStringLiteral("CRMContactGone")));
    createDatabase(dir + QStringLiteral("no_docs.db"),
                   QStringLiteral("CREATE TABLE DocumentsDef (DocumentID INTEGER, DocName TEXT);\n"
                                  "INSERT INTO DocumentsDef VALUES (0, 'פנימי');\n"
                                  "INSERT INTO DocumentsDef VALUES (-3, 'מבוטל');\n"));
    createDatabase(
        dir + QStringLiteral("empty_docs.db"),
        QStringLiteral("CREATE TABLE DocumentsDef (DocumentID INTEGER, DocName TEXT);\n"));

    // An ODBC data source on a port where nothing listens, in an ini of the
    // test's own so that the machine's data sources are left alone.
    const QString odbcDir = dataDir_.path() + QStringLiteral("/odbc");
    QDir().mkpath(odbcDir);
    QFile inst(odbcDir + QStringLiteral("/odbcinst.ini"));
    QVERIFY(inst.open(QIODevice::WriteOnly));
    inst.write("[PostgreSQL Unicode]\nDriver=psqlodbcw.so\n");
    inst.close();
    QFile ini(odbcDir + QStringLiteral("/odbc.ini"));
    QVERIFY(ini.open(QIODevice::WriteOnly));
    ini.write("[ardcard_nowhere]\nDriver=PostgreSQL Unicode\nServername=127.0.0.1\nPort=1\n"
              "Database=none\n");
    ini.close();
    qputenv("ODBCSYSINI", QFile::encodeName(odbcDir));
    qputenv("ODBCINI", QFile::encodeName(odbcDir + QStringLiteral("/odbc.ini")));
}

void TestInfo::cleanup() {
    messages_.clear();
    windows_.clear();
    for (const char* name : {"vlicrd0.htm", "vlicrd1.htm", "vlinf0.htm", "vlinf1.htm"})
        QFile::remove(tempFile(QString::fromLatin1(name)));
}

void TestInfo::keyLiteral_data() {
    QTest::addColumn<QString>("key");
    QTest::addColumn<int>("connType");
    QTest::addColumn<QString>("literal");
    QTest::newRow("plain") << "1001" << 4 << "'1001'";
    QTest::newRow("apostrophe odbc") << "AB'12" << 1 << "'AB''12'";
    QTest::newRow("apostrophe unicode server") << "AB'12" << 2 << "N'AB''12'";
    QTest::newRow("two apostrophes") << "''" << 4 << "''''''";
    QTest::newRow("empty") << "" << 2 << "N''";
}

void TestInfo::keyLiteral() {
    QFETCH(QString, key);
    QFETCH(int, connType);
    QFETCH(QString, literal);
    QCOMPARE(info::KeyLiteral(key, connType), literal);
}

void TestInfo::docTypeCode_data() {
    QTest::addColumn<qint64>("code");
    QTest::addColumn<QString>("text");
    QTest::newRow("five") << qint64(5) << " 5 ";
    QTest::newRow("twelve") << qint64(12) << " 12 ";
    QTest::newRow("zero") << qint64(0) << " 0 ";
    QTest::newRow("negative") << qint64(-3) << "-3 ";
}

void TestInfo::docTypeCode() {
    QFETCH(qint64, code);
    QFETCH(QString, text);
    QCOMPARE(info::DocTypeCodeText(code), text);
}

void TestInfo::waitPage() {
    Ard7Info info;
    info.CreateWaitHTML(tempFile(QStringLiteral("wait.htm")));
    QVERIFY(samePage(tempFile(QStringLiteral("wait.htm")),
                     referenceBytes(QStringLiteral("wait.htm")), QStringLiteral("wait.htm")));
}

void TestInfo::accountPage_data() {
    QTest::addColumn<QString>("key");
    QTest::addColumn<QString>("reference");
    QTest::newRow("every section") << "1001"
                                   << "account_1001.htm";
    QTest::newRow("no contacts, keys or prices") << "2002"
                                                 << "account_2002.htm";
    QTest::newRow("unknown key: title only") << "9999"
                                             << "account_unknown.htm";
    QTest::newRow("markup and apostrophes escaped") << "AB'12"
                                                    << "account_ab12.htm";
    // The account is found in another letter case; the later queries use the
    // key as stored, so its contact and note are found too.
    QTest::newRow("key in other letter case") << "ab'12"
                                              << "account_ab12.htm";
}

void TestInfo::accountPage() {
    QFETCH(QString, key);
    QFETCH(QString, reference);
    Ard7Info info;
    const QString path = tempFile(QStringLiteral("account.htm"));
    info.CreateAccountHTML(path, key, connString(QStringLiteral("company.db")), 4);
    QVERIFY(samePage(path, referenceBytes(reference), reference));
}

void TestInfo::itemPage_data() {
    QTest::addColumn<QString>("key");
    QTest::addColumn<QString>("reference");
    QTest::newRow("every section, trees 2 2 3") << "A100"
                                                << "item_a100.htm";
    QTest::newRow("no price lists") << "B200"
                                    << "item_b200.htm";
}

void TestInfo::itemPage() {
    QFETCH(QString, key);
    QFETCH(QString, reference);
    Ard7Info info;
    const QString path = tempFile(QStringLiteral("item.htm"));
    info.CreateItemHTML(path, key, connString(QStringLiteral("company.db")), 4);
    QVERIFY(samePage(path, referenceBytes(reference), reference));
}

void TestInfo::unknownItemGivesEmptyFile() {
    Ard7Info info;
    const QString path = tempFile(QStringLiteral("item.htm"));
    info.CreateItemHTML(path, QStringLiteral("ZZZ"), connString(QStringLiteral("company.db")), 4);
    QVERIFY(QFileInfo::exists(path));
    QCOMPARE(QFileInfo(path).size(), 0);
}

void TestInfo::docTypesPage_data() {
    QTest::addColumn<QString>("database");
    QTest::addColumn<QString>("reference");
    QTest::newRow("null name, type 0 left out") << "company.db"
                                                << "doctypes.htm";
    QTest::newRow("none above 0") << "no_docs.db"
                                  << "doctypes_none.htm";
}

void TestInfo::docTypesPage() {
    QFETCH(QString, database);
    QFETCH(QString, reference);
    Ard7Info info;
    const QString path = tempFile(QStringLiteral("doctypes.htm"));
    info.CreateDocTypeHTML(path, connString(database));
    QVERIFY(samePage(path, referenceBytes(reference), reference));
}

void TestInfo::showAccountSequence() {
    Ard7Info info;
    info.OpenAccountHTML(QStringLiteral("  1001 "), connString(QStringLiteral("company.db")), 4);
    QVERIFY(messages_.messages().isEmpty());
    const QList<QStringList> expected{
        {tempFile(QStringLiteral("vlicrd0.htm")), tempFile(QStringLiteral("vlicrd1.htm"))}};
    QCOMPARE(windows_.windows(), expected);
    QVERIFY(samePage(tempFile(QStringLiteral("vlicrd0.htm")),
                     referenceBytes(QStringLiteral("wait.htm")), QStringLiteral("wait.htm")));
    QVERIFY(samePage(tempFile(QStringLiteral("vlicrd1.htm")),
                     referenceBytes(QStringLiteral("account_1001.htm")),
                     QStringLiteral("account_1001.htm")));
}

void TestInfo::showItemSequence() {
    Ard7Info info;
    info.OpenItemHTML(QStringLiteral(" A100  "), connString(QStringLiteral("company.db")), 4);
    QVERIFY(messages_.messages().isEmpty());
    const QList<QStringList> expected{
        {tempFile(QStringLiteral("vlicrd0.htm")), tempFile(QStringLiteral("vlicrd1.htm"))}};
    QCOMPARE(windows_.windows(), expected);
    QVERIFY(samePage(tempFile(QStringLiteral("vlicrd1.htm")),
                     referenceBytes(QStringLiteral("item_a100.htm")),
                     QStringLiteral("item_a100.htm")));
}

void TestInfo::showInfoSequence() {
    Ard7Info info;
    info.OpenInfoHTML(1, connString(QStringLiteral("company.db")), 4);
    QVERIFY(messages_.messages().isEmpty());
    const QList<QStringList> expected{
        {tempFile(QStringLiteral("vlinf0.htm")), tempFile(QStringLiteral("vlinf1.htm"))}};
    QCOMPARE(windows_.windows(), expected);
    QVERIFY(samePage(tempFile(QStringLiteral("vlinf0.htm")),
                     referenceBytes(QStringLiteral("wait.htm")), QStringLiteral("wait.htm")));
    QVERIFY(samePage(tempFile(QStringLiteral("vlinf1.htm")),
                     referenceBytes(QStringLiteral("doctypes.htm")),
                     QStringLiteral("doctypes.htm")));
}

void TestInfo::showInfoOtherTypeWritesOnlyWaitPage() {
    Ard7Info info;
    info.OpenInfoHTML(2, connString(QStringLiteral("company.db")), 4);
    QVERIFY(messages_.messages().isEmpty());
    const QList<QStringList> expected{
        {tempFile(QStringLiteral("vlinf0.htm")), tempFile(QStringLiteral("vlinf1.htm"))}};
    QCOMPARE(windows_.windows(), expected);
    QVERIFY(QFileInfo::exists(tempFile(QStringLiteral("vlinf0.htm"))));
    QVERIFY(!QFileInfo::exists(tempFile(QStringLiteral("vlinf1.htm"))));
}

void TestInfo::failureHalfWayLeavesWindowOnWaitPage() {
    Ard7Info info;
    info.OpenAccountHTML(QStringLiteral("1001"), connString(QStringLiteral("no_crm.db")), 4);

    QCOMPARE(messages_.messages().size(), 1);
    const host::Message& message = messages_.messages().first();
    QCOMPARE(message.title, QStringLiteral("תקלה"));
    QCOMPARE(message.icon, host::MessageIcon::Critical);
    QVERIFY2(message.text.contains(QStringLiteral("CRMContact")), qPrintable(message.text));

    const QList<QStringList> expected{{tempFile(QStringLiteral("vlicrd0.htm"))}};
    QCOMPARE(windows_.windows(), expected);

    // The page holds every line up to the contacts cell, which failed.
    const QByteArray full = referenceBytes(QStringLiteral("account_1001.htm"));
    const QByteArray cut = "<tr valign='top'><td colspan=2>\r\n";
    const qsizetype at = full.indexOf(cut);
    QVERIFY(at > 0);
    QVERIFY(samePage(tempFile(QStringLiteral("vlicrd1.htm")), full.left(at + cut.size()),
                     QStringLiteral("account_1001_cut.htm")));
    // Closed: the file can be replaced at once by the next request.
    QVERIFY(QFile::remove(tempFile(QStringLiteral("vlicrd1.htm"))));
}

void TestInfo::checkConnection_data() {
    QTest::addColumn<int>("connType");
    QTest::addColumn<QString>("storedDatabase");
    QTest::addColumn<QString>("compPath");
    QTest::addColumn<bool>("answers");
    QTest::newRow("stored database") << 4 << "company.db"
                                     << "" << true;
    QTest::newRow("no document type 1") << 4 << "company.db"
                                        << "empty_docs.db" << true;
    QTest::newRow("missing file") << 4 << "company.db"
                                  << "missing.db" << false;
    QTest::newRow("no table") << 4 << "company.db"
                              << "nothing.db" << false;
    QTest::newRow("no connection type") << 0 << "company.db"
                                        << "" << false;
    QTest::newRow("server not listening") << 5 << "ardcard_nowhere"
                                          << "" << false;
}

void TestInfo::checkConnection() {
    QFETCH(int, connType);
    QFETCH(QString, storedDatabase);
    QFETCH(QString, compPath);
    QFETCH(bool, answers);
    if (compPath == QStringLiteral("nothing.db"))
        createDatabase(dataDir_.path() + QStringLiteral("/nothing.db"),
                       QStringLiteral("CREATE TABLE Other (X INTEGER);\n"));

    ConnValues& conn = moduleState().conn;
    const ConnValues saved = conn;
    conn = ConnValues{connType == 5 ? QString() : dataDir_.path(), QString(), QString(),
                      storedDatabase, connType};
    Ard7Info info;
    const bool result = info.CheckConnArd7(compPath);
    conn = saved;
    QCOMPARE(result, answers);
    QVERIFY(messages_.messages().isEmpty());
    QVERIFY(windows_.windows().isEmpty());
}

void TestInfo::cardKeyImageOpensAccountPage_data() {
    QTest::addColumn<QString>("typedKey");
    QTest::addColumn<bool>("opens");
    QTest::newRow("key with spaces") << " 1001  " << true;
    QTest::newRow("empty key") << "   " << false;
}

// A double click on the card's key image opens the account page of the key
// on show, through the stored connection values.
void TestInfo::cardKeyImageOpensAccountPage() {
    QFETCH(QString, typedKey);
    QFETCH(bool, opens);
    Card card;
    ConnValues& conn = moduleState().conn;
    const ConnValues saved = conn;
    conn = ConnValues{dataDir_.path(), QString(), QString(), QStringLiteral("company.db"), 4};
    auto* keyBox = card.findChild<QLineEdit*>(QStringLiteral("txtAccountKey"));
    auto* image = card.findChild<QWidget*>(QStringLiteral("imgAccKey"));
    QVERIFY(keyBox);
    QVERIFY(image);
    keyBox->setText(typedKey);
    QTest::mouseDClick(image, Qt::LeftButton);
    conn = saved;

    QVERIFY(messages_.messages().isEmpty());
    if (!opens) {
        QVERIFY(windows_.windows().isEmpty());
        return;
    }
    const QList<QStringList> expected{
        {tempFile(QStringLiteral("vlicrd0.htm")), tempFile(QStringLiteral("vlicrd1.htm"))}};
    QCOMPARE(windows_.windows(), expected);
    QVERIFY(samePage(tempFile(QStringLiteral("vlicrd1.htm")),
                     referenceBytes(QStringLiteral("account_1001.htm")),
                     QStringLiteral("account_1001.htm")));
}

QTEST_MAIN(TestInfo)
#include "test_info.moc"
