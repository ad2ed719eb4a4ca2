// Faults from outside the program: company files that are cut short, are no
// database or are not there, a temporary directory that cannot be written, a
// settings file that cannot be read or written or holds garbage. Each command
// must say what went wrong in its own words, go on where it promises to, keep
// no file open, open no window on a page it could not write, and never show
// the password.

#include "card/card.h"
#include "card_fixture.h"
#include "common/module_state.h"
#include "connection/conn_string.h"
#include "connection/settings_store.h"
#include "host/seams.h"
#include "hostile_support.h"
#include "info/ard7info.h"
#include "ledger/ledger_model.h"

#include <QCheckBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRandomGenerator>
#include <QTest>

using namespace ardcard;

namespace {

const QString kLookupTitle = QStringLiteral("תקלה בקריאת החשבונות");
const QString kFailureTitle = QStringLiteral("תקלה");

void setEnvPath(const char* name, const QString& path) {
    qputenv(name, QFile::encodeName(path));
}

bool writeFile(const QString& path, const QByteArray& bytes) {
    QFile file(path);
    if (!file.open(QIODevice::WriteOnly | QIODevice::Truncate))
        return false;
    return file.write(bytes) == bytes.size();
}

QByteArray readFile(const QString& path) {
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

} // namespace

class TestFaults : public QObject {
    Q_OBJECT

private:
    QTemporaryDir root_;
    QString companies_; // company files
    QString temp_;      // the temporary directory in force when nothing is wrong
    QString config_;    // XDG_CONFIG_HOME
    host::MessageRecorder messages_;
    host::PageWindowRecorder windows_;
    std::unique_ptr<host::ScopedSeams> seams_;
    QMap<QString, QByteArray> fingerprints_;

    QString company(const QString& file) const { return QDir(companies_).filePath(file); }

    void useConnection(const QString& database) {
        // Type 6 puts the password into the connection string itself.
        moduleState().conn =
            ConnValues{companies_, QStringLiteral("clerk"), hostile::kPassword, database, 6};
    }
    QString connString(const QString& database) const {
        return BuildConnString(companies_, QStringLiteral("clerk"), hostile::kPassword, database,
                               6);
    }

    std::unique_ptr<Card> placedCard(const QString& dirs) {
        auto card = std::make_unique<Card>();
        useConnection(QStringLiteral("good.db"));
        card->setCompDir(dirs);
        card->resize(900, 640);
        card->show();
        if (!QTest::qWaitForWindowExposed(card.get()))
            qWarning("card not exposed");
        return card;
    }
    template <typename T> static T* child(const Card& card, const char* name) {
        auto* widget = card.findChild<T*>(QString::fromLatin1(name));
        if (!widget)
            qFatal("no control %s", name);
        return widget;
    }
    static void click(const Card& card, const char* button) {
        QTest::mouseClick(child<QPushButton>(card, button), Qt::LeftButton);
    }
    // The fetch of account 1001 from good.db alone: one row, every output
    // button enabled, the graph with one bar.
    std::unique_ptr<Card> fetchedCard() {
        auto card = placedCard(QStringLiteral("good.db"));
        child<QLineEdit>(*card, "txtAccountKey")->setText(QStringLiteral("1001"));
        click(*card, "ShowTransButt");
        return card;
    }

private Q_SLOTS:
    void initTestCase();
    void init();
    void cleanup();
    void cleanupTestCase();

    void lookupInBadCompany_data();
    void lookupInBadCompany();
    void fetchGoesOnAfterBadCompany_data();
    void fetchGoesOnAfterBadCompany();
    void infoPageOfBadCompany_data();
    void infoPageOfBadCompany();

    void unwritableTemp_data();
    void unwritableTemp();

    void unreadableSettingsGiveDefaults();
    void garbageSettingsGiveDefaults_data();
    void garbageSettingsGiveDefaults();
    void saveOptionsUnwritable_data();
    void saveOptionsUnwritable();
};

void TestFaults::initTestCase() {
    QVERIFY(root_.isValid());
    companies_ = root_.filePath(QStringLiteral("companies"));
    temp_ = root_.filePath(QStringLiteral("temp"));
    config_ = root_.filePath(QStringLiteral("config"));
    for (const QString& d : {companies_, temp_, config_})
        QVERIFY(QDir().mkpath(d));
    setEnvPath("XDG_CONFIG_HOME", config_);
    setEnvPath("TMPDIR", temp_);
    setEnvPath("Temp", temp_);
    seams_ = std::make_unique<host::ScopedSeams>(&messages_, &windows_);

    // One account with one journal line of 100 in March 2024.
    const QStringList goodRows = {
        fixture::companyRow(QStringLiteral("1, 'חברה תקינה', 'תקינה', '', '', ''")),
        fixture::accountRow(QStringLiteral("1, '1001', 'לקוח טוב', '03-1', 'רחוב 1', 'פרטים',"
                                           " '', 100, 0, 0, 'עיר', '1', '', 1, 0")),
        QStringLiteral("INSERT INTO Currencies (ID, CurrencyCode) VALUES (1, 'ש\"ח')"),
        QStringLiteral("INSERT INTO JurnalTrans (TransID, Type, Status, FixedID, ValueDate,"
                       " DueDate, BatchNo, Referance, Ref2, Description, CostCode, CurrencyCode,"
                       " TransDebID, TransCredID) VALUES (1, 0, 1, 0, '2024-03-05', '2024-03-05',"
                       " 7, 10, 0, 'שורה', '', 'ש\"ח', '1001', '2002')"),
        QStringLiteral("INSERT INTO JurnalTransMoves (ID, TransID, AccountKey, SuF, SuFDlr,"
                       " DebitCredit, FullMatch) VALUES (1, 1, '1001', 100, 0, 0, 0)"),
    };
    QVERIFY(fixture::createDatabase(companies_, QStringLiteral("good.db"), goodRows));
    QVERIFY(fixture::createDatabase(companies_, QStringLiteral("whole.db"), goodRows));

    // Cut short: the header says SQLite, the pages that hold the tables are gone.
    const QByteArray whole = readFile(company(QStringLiteral("whole.db")));
    QVERIFY(whole.size() > 4096);
    QVERIFY(writeFile(company(QStringLiteral("truncated.db")), whole.left(1024)));
    // The SQLite header followed by noise.
    QByteArray noisy = whole.left(100);
    QRandomGenerator random(1255);
    for (int i = 0; i < 8192; ++i)
        noisy.append(static_cast<char>(random.bounded(256)));
    QVERIFY(writeFile(company(QStringLiteral("corrupt.db")), noisy));
    // Noise from the first byte: no database of any kind.
    QByteArray garbage;
    for (int i = 0; i < 8192; ++i)
        garbage.append(static_cast<char>(random.bounded(256)));
    QVERIFY(writeFile(company(QStringLiteral("garbage.db")), garbage));
    QVERIFY(writeFile(company(QStringLiteral("empty.db")), QByteArray()));
    QVERIFY(QDir().mkpath(company(QStringLiteral("folder.db"))));

    for (const char* file : {"good.db", "truncated.db", "corrupt.db", "garbage.db", "empty.db"}) {
        const QString path = company(QString::fromLatin1(file));
        fingerprints_.insert(path, hostile::fingerprint(path));
    }
}

void TestFaults::init() {
    const QString ini = QDir(config_).filePath(QStringLiteral("VL7Trans.ini"));
    QDir(ini).removeRecursively();
    QFile::remove(ini);
    moduleState() = ModuleState{};
    setEnvPath("TMPDIR", temp_);
    setEnvPath("XDG_CONFIG_HOME", config_);
    messages_.clear();
    windows_.clear();
}

void TestFaults::cleanup() {
    QVERIFY2(hostile::leakingMessages(messages_.messages()).isEmpty(),
             qPrintable(hostile::leakingMessages(messages_.messages()).join(u'\n')));
    for (auto it = fingerprints_.cbegin(); it != fingerprints_.cend(); ++it)
        QVERIFY2(hostile::fingerprint(it.key()) == it.value(), qPrintable(it.key()));
    QVERIFY2(hostile::openFilesUnder(companies_).isEmpty(),
             qPrintable(hostile::openFilesUnder(companies_).join(u'\n')));
}

void TestFaults::cleanupTestCase() {
    seams_.reset();
}

// ---- company files ----------------------------------------------------------

void TestFaults::lookupInBadCompany_data() {
    QTest::addColumn<QString>("database");
    QTest::newRow("cut short") << QStringLiteral("truncated.db");
    QTest::newRow("header then noise") << QStringLiteral("corrupt.db");
    QTest::newRow("noise") << QStringLiteral("garbage.db");
    QTest::newRow("empty file") << QStringLiteral("empty.db");
    QTest::newRow("a folder") << QStringLiteral("folder.db");
    QTest::newRow("missing") << QStringLiteral("no-such-company.db");
    QTest::newRow("missing folder") << QStringLiteral("no-such-folder\\co.db");
}

void TestFaults::lookupInBadCompany() {
    QFETCH(QString, database);
    auto card = placedCard(database);
    useConnection(database);
    messages_.clear();
    child<QLineEdit>(*card, "txtAccountKey")->setText(QStringLiteral("1001"));
    QTest::mouseDClick(child<QLabel>(*card, "Label1"), Qt::LeftButton);

    QCOMPARE(messages_.messages().size(), 1);
    const host::Message& m = messages_.messages().first();
    QCOMPARE(m.title, kLookupTitle);
    QCOMPARE(m.icon, host::MessageIcon::Critical);
    QVERIFY(!m.text.trimmed().isEmpty());
    QCOMPARE(card->PubACTLocation, 0);
    QVERIFY(windows_.windows().isEmpty());
    // The direct call says the lookup did not run to its end.
    messages_.clear();
    QCOMPARE(card->ReadACT7(database, QStringLiteral("AccountKey"), QStringLiteral("1001"),
                            QStringLiteral("First")),
             QVariant(false));
    QCOMPARE(messages_.messages().size(), 1);
}

void TestFaults::fetchGoesOnAfterBadCompany_data() {
    lookupInBadCompany_data();
}

void TestFaults::fetchGoesOnAfterBadCompany() {
    QFETCH(QString, database);
    auto card = placedCard(database + QStringLiteral(";good.db"));
    messages_.clear();
    child<QLineEdit>(*card, "txtAccountKey")->setText(QStringLiteral("1001"));
    click(*card, "ShowTransButt");

    // The bad company says so once, with the information icon; the good one
    // after it is read all the same.
    QCOMPARE(messages_.messages().size(), 1);
    QCOMPARE(messages_.messages().first().title, kFailureTitle);
    QCOMPARE(messages_.messages().first().icon, host::MessageIcon::Information);
    const LedgerModel& ledger = card->ledger();
    QCOMPARE(ledger.dataRowCount(), 1);
    QCOMPARE(ledger.rowDetail(1).CompIndex, 2);
    QCOMPARE(ledger.cellText(1, 8), QStringLiteral("100.00"));
    QCOMPARE(moduleState().CompanyDirCount, 2);
    QVERIFY(child<QPushButton>(*card, "PrintButt")->isEnabled());
}

void TestFaults::infoPageOfBadCompany_data() {
    QTest::addColumn<QString>("database");
    QTest::addColumn<QString>("page"); // account, item, types
    for (const char* page : {"account", "item", "types"}) {
        const QString p = QString::fromLatin1(page);
        QTest::addRow("%s, cut short", page) << QStringLiteral("truncated.db") << p;
        QTest::addRow("%s, noise", page) << QStringLiteral("garbage.db") << p;
        QTest::addRow("%s, missing", page) << QStringLiteral("no-such-company.db") << p;
    }
}

void TestFaults::infoPageOfBadCompany() {
    QFETCH(QString, database);
    QFETCH(QString, page);
    const QStringList before = hostile::openFiles();
    Ard7Info info;
    const QString conn = connString(database);
    QString waitFile = QStringLiteral("vlicrd0.htm");
    if (page == QStringLiteral("account")) {
        info.OpenAccountHTML(QStringLiteral(" 1001 "), conn, 6);
    } else if (page == QStringLiteral("item")) {
        info.OpenItemHTML(QStringLiteral("A1"), conn, 6);
    } else {
        info.OpenInfoHTML(1, conn, 6);
        waitFile = QStringLiteral("vlinf0.htm");
    }

    QCOMPARE(messages_.messages().size(), 1);
    QCOMPARE(messages_.messages().first().title, kFailureTitle);
    QCOMPARE(messages_.messages().first().icon, host::MessageIcon::Critical);
    // The window stays on the wait page.
    QCOMPARE(windows_.windows().size(), 1);
    QCOMPARE(windows_.windows().first(), QStringList{QDir(temp_).filePath(waitFile)});
    QCOMPARE(hostile::openFiles(), before);
}

// ---- the temporary directory --------------------------------------------------

void TestFaults::unwritableTemp_data() {
    QTest::addColumn<QString>("temp"); // relative to the test's root
    QTest::addColumn<QString>("command");
    const QStringList commands = {QStringLiteral("PrintButt"),  QStringLiteral("ExcelButt"),
                                  QStringLiteral("CmdGraph"),   QStringLiteral("imgAccKey"),
                                  QStringLiteral("itemPage"),   QStringLiteral("typesPage"),
                                  QStringLiteral("accountPage")};
    for (const QString& command : commands) {
        QTest::addRow("under a file, %s", qPrintable(command))
            << QStringLiteral("plain-file/temp") << command;
        QTest::addRow("a file in its place, %s", qPrintable(command))
            << QStringLiteral("plain-file") << command;
    }
}

void TestFaults::unwritableTemp() {
    QFETCH(QString, temp);
    QFETCH(QString, command);
    QVERIFY(writeFile(root_.filePath(QStringLiteral("plain-file")), "not a directory\n"));
    auto card = fetchedCard();
    QCOMPARE(card->ledger().dataRowCount(), 1);
    QVERIFY(child<QPushButton>(*card, "CmdGraph")->isEnabled());
    messages_.clear();

    // Earlier tests' pages go, so that a page written here would show.
    QDir(temp_).removeRecursively();
    QVERIFY(QDir().mkpath(temp_));
    const QString badTemp = root_.filePath(temp);
    setEnvPath("TMPDIR", badTemp);
    const QStringList before = hostile::openFiles();
    if (command == QStringLiteral("imgAccKey")) {
        QTest::mouseDClick(child<QLabel>(*card, "imgAccKey"), Qt::LeftButton);
    } else if (command.endsWith(QStringLiteral("Page"))) {
        Ard7Info info;
        if (command == QStringLiteral("itemPage"))
            info.OpenItemHTML(QStringLiteral("A1"), connString(QStringLiteral("good.db")), 6);
        else if (command == QStringLiteral("typesPage"))
            info.OpenInfoHTML(1, connString(QStringLiteral("good.db")), 6);
        else
            info.OpenAccountHTML(QStringLiteral("1001"), connString(QStringLiteral("good.db")), 6);
    } else {
        click(*card, qPrintable(command));
    }
    const QStringList after = hostile::openFiles();
    setEnvPath("TMPDIR", temp_);

    QCOMPARE(messages_.messages().size(), 1);
    QCOMPARE(messages_.messages().first().title, kFailureTitle);
    QCOMPARE(messages_.messages().first().icon, host::MessageIcon::Critical);
    QVERIFY(!messages_.messages().first().text.isEmpty());
    QVERIFY(windows_.windows().isEmpty());
    QCOMPARE(after, before);
    QVERIFY(hostile::openFilesUnder(root_.path()).isEmpty());
    // Nothing went anywhere else instead: not to the root of the file system,
    // not to the temporary directory in force before.
    for (const char* name : {"vlprint.htm", "vltrans1.csv", "vltrans1.htm", "vtransg.htm",
                             "vlicrd0.htm", "vlicrd1.htm", "vlinf0.htm", "vlinf1.htm"}) {
        QVERIFY2(!QFile::exists(QStringLiteral("/") + QString::fromLatin1(name)), name);
        QVERIFY2(!QFile::exists(QDir(temp_).filePath(QString::fromLatin1(name))), name);
    }
}

// ---- the settings file --------------------------------------------------------

namespace {

// Loads the options into a card whose controls hold other values first, and
// the connection values into a state that holds others first.
void loadOptionsOverOtherValues(Card& card) {
    card.findChild<QLineEdit*>(QStringLiteral("txtCompPath"))->setText(QStringLiteral("other.db"));
    for (const char* box : {"ChkOnlyOpenTrans", "chkNegdiName", "chkShowHeadDetails"})
        card.findChild<QCheckBox*>(QString::fromLatin1(box))->setChecked(true);
    moduleState().conn = ConnValues{QStringLiteral("s"), QStringLiteral("u"), QStringLiteral("p"),
                                    QStringLiteral("d"), 5};
    card.SetGetRegParams(2, QStringLiteral("VL7Trans"), QStringLiteral("Params"));
    ReadConnParams();
}

void verifyDefaults(const Card& card) {
    QCOMPARE(card.findChild<QLineEdit*>(QStringLiteral("txtCompPath"))->text(),
             QStringLiteral("demo.mdb"));
    QCOMPARE(moduleState().CompanyDirText, QStringLiteral("demo.mdb"));
    for (const char* box : {"ChkOnlyOpenTrans", "chkNegdiName", "chkShowHeadDetails"})
        QVERIFY2(!card.findChild<QCheckBox*>(QString::fromLatin1(box))->isChecked(), box);
    QCOMPARE(moduleState().MainDrive, QString());
    QCOMPARE(moduleState().MainDir, QString());
    const ConnValues& c = moduleState().conn;
    QCOMPARE(c.ConnServer, QStringLiteral("server"));
    QCOMPARE(c.ConnUID, QStringLiteral("sa"));
    QCOMPARE(c.ConnPWD, QString());
    QCOMPARE(c.ConnDataBase, QStringLiteral("velmor02"));
    QCOMPARE(c.ConnType, 1);
}

} // namespace

void TestFaults::unreadableSettingsGiveDefaults() {
    const QString ini = QDir(config_).filePath(QStringLiteral("VL7Trans.ini"));
    QVERIFY(QDir().mkpath(ini));
    Card card; // creation reads the connection values
    loadOptionsOverOtherValues(card);
    verifyDefaults(card);
    QVERIFY(messages_.messages().isEmpty());
    QVERIFY(QDir().rmdir(ini));
}

void TestFaults::garbageSettingsGiveDefaults_data() {
    QTest::addColumn<QByteArray>("content");
    QRandomGenerator random(65001);
    QByteArray noise;
    for (int i = 0; i < 64 * 1024; ++i)
        noise.append(static_cast<char>(random.bounded(256)));
    // The noise must not happen to hold a key line.
    noise.replace('=', 'x');
    QTest::newRow("random bytes") << noise;
    QTest::newRow("NULs") << QByteArray(64 * 1024, '\0');
    QTest::newRow("one huge line") << QByteArray(8 * 1024 * 1024, 'x');
    QTest::newRow("huge line in the section")
        << QByteArray("[Params]\n") + QByteArray(4 * 1024 * 1024, 'y') + "\n";
    QTest::newRow("NULs in the section")
        << QByteArray("[Params]\n") + QByteArray(1024, '\0') + "\n[Other]\nCompanyDir=x.db\n";
    QTest::newRow("broken section lines")
        << QByteArray("[Params\n]\n[\n=\n==\n\xff\xfe[Params]\xff\n");
}

void TestFaults::garbageSettingsGiveDefaults() {
    QFETCH(QByteArray, content);
    const QString ini = QDir(config_).filePath(QStringLiteral("VL7Trans.ini"));
    QVERIFY(writeFile(ini, content));
    Card card;
    loadOptionsOverOtherValues(card);
    verifyDefaults(card);
    QVERIFY(messages_.messages().isEmpty());
}

void TestFaults::saveOptionsUnwritable_data() {
    QTest::addColumn<QString>("config"); // relative to the test's root
    QTest::addColumn<bool>("iniIsFolder");
    QTest::newRow("settings file is a folder") << QStringLiteral("config") << true;
    QTest::newRow("settings folder under a file") << QStringLiteral("plain-file/config") << false;
    QTest::newRow("settings folder is a file") << QStringLiteral("plain-file") << false;
}

void TestFaults::saveOptionsUnwritable() {
    QFETCH(QString, config);
    QFETCH(bool, iniIsFolder);
    QVERIFY(writeFile(root_.filePath(QStringLiteral("plain-file")), "not a directory\n"));
    const QString folderIni = QDir(config_).filePath(QStringLiteral("VL7Trans.ini"));
    if (iniIsFolder)
        QVERIFY(QDir().mkpath(folderIni));
    setEnvPath("XDG_CONFIG_HOME", root_.filePath(config));
    // The password is in force, as it is after a connection was made.
    auto card = placedCard(QStringLiteral("good.db"));
    messages_.clear();
    const QStringList before = hostile::openFiles();
    click(*card, "cmdSave");
    QCOMPARE(hostile::openFiles(), before);
    setEnvPath("XDG_CONFIG_HOME", config_);
    if (iniIsFolder)
        QVERIFY(QDir().rmdir(folderIni));

    QCOMPARE(messages_.messages().size(), 1);
    QCOMPARE(messages_.messages().first().title, kFailureTitle);
    QCOMPARE(messages_.messages().first().icon, host::MessageIcon::Critical);
    QVERIFY(!messages_.messages().first().text.isEmpty());
    QCOMPARE(readFile(root_.filePath(QStringLiteral("plain-file"))),
             QByteArray("not a directory\n"));
}

QTEST_MAIN(TestFaults)
#include "test_faults.moc"
