// The card against a real PostgreSQL server, reached through the ODBC driver
// manager with the type-1 string ("driver={SQL Server};...") and the type-5
// data-source string exactly as they are built. The same fixture companies
// live in SQLite files read with the Jet string (type 4); every output the
// card shows or writes must be the same on both engines, and a few values are
// checked as written by hand. Then the server is stopped, given a wrong
// password, a database without accounts and an address that never answers.
//
// The server, its private ODBC configuration and the fixture databases are
// made by tests/pg/start.sh before this program runs; the state file it
// writes says where they are.

#include "card/card.h"
#include "card_fixture.h"
#include "common/module_state.h"
#include "connection/conn_dialog.h"
#include "connection/conn_string.h"
#include "host/seams.h"
#include "info/ard7info.h"
#include "ledger/ledger_model.h"
#include "pg/pg_fixture.h"

#include <QApplication>
#include <QComboBox>
#include <QDate>
#include <QElapsedTimer>
#include <QFile>
#include <QLabel>
#include <QLineEdit>
#include <QProcess>
#include <QPushButton>
#include <QSettings>
#include <QTest>
#include <QTimer>

#include <arpa/inet.h>
#include <fcntl.h>
#include <netinet/in.h>
#include <sys/socket.h>
#include <unistd.h>

using namespace ardcard;

namespace {

const QString kWrongPassword = QStringLiteral("Wrong-pw-4711");
const QString kLookupTitle = QStringLiteral("תקלה בקריאת החשבונות");
const QString kFailureTitle = QStringLiteral("תקלה");

const QStringList kBoxes = {
    QStringLiteral("txtAccountKey"), QStringLiteral("txtAccountName"),
    QStringLiteral("txtBalance"),    QStringLiteral("txtAddress"),
    QStringLiteral("txtCity"),       QStringLiteral("txtTelephone"),
    QStringLiteral("txtOblig"),      QStringLiteral("txtShipBalance"),
    QStringLiteral("txtDetails"),    QStringLiteral("txtZip"),
    QStringLiteral("txtDistrict"),   QStringLiteral("txtAgent"),
};

const QStringList kAccount1001 = {
    QStringLiteral("1001"),     QStringLiteral("אבי כהן"), QStringLiteral("1,234.50"),
    QStringLiteral("הרצל 1"),   QStringLiteral("תל אביב"), QStringLiteral("03-1111111"),
    QStringLiteral("5,000.00"), QStringLiteral("0.00"),    QStringLiteral("לקוח ותיק"),
    QStringLiteral("61000"),    QStringLiteral("מרכז"),    QStringLiteral("7"),
};

// The grid rows of account 1001 over both companies, cell by cell.
const QList<QStringList> kLedger1001 = {
    {QStringLiteral("1"), QStringLiteral("15/01/24"), QStringLiteral("10"), QStringLiteral("1"),
     QStringLiteral("15/02/24"), QStringLiteral("501"), QStringLiteral("0"),
     QStringLiteral("חשבונית 501"), QStringLiteral("1,170.00"), QStringLiteral("0.00"),
     QStringLiteral("ש\"ח"), QStringLiteral("1,170.00"), QStringLiteral("A1"), QStringLiteral("0"),
     QStringLiteral("0"), QStringLiteral("0"), QStringLiteral("1")},
    {QStringLiteral("2"), QStringLiteral("01/02/24"), QStringLiteral("11"), QStringLiteral("2"),
     QStringLiteral("01/02/24"), QStringLiteral("77"), QStringLiteral("0"), QStringLiteral("קבלה"),
     QStringLiteral("-370.00"), QStringLiteral("-100.00"), QStringLiteral("$"),
     QStringLiteral("800.00"), QStringLiteral(" "), QStringLiteral("3"), QStringLiteral("0"),
     QStringLiteral("0"), QStringLiteral("2")},
    {QStringLiteral("3"), QStringLiteral("10/03/24"), QStringLiteral("12"), QStringLiteral("3"),
     QStringLiteral("10/04/24"), QStringLiteral("502"), QStringLiteral("9"), QStringLiteral(" "),
     QStringLiteral("2,000.50"), QStringLiteral("500.00"), QStringLiteral("EUR"),
     QStringLiteral("2,800.50"), QStringLiteral("B2"), QStringLiteral("0"), QStringLiteral("0"),
     QStringLiteral("0"), QStringLiteral("3")},
    {QStringLiteral("1"), QStringLiteral("05/05/24"), QStringLiteral("1"), QStringLiteral("1"),
     QStringLiteral("05/05/24"), QStringLiteral("9001"), QStringLiteral("0"),
     QStringLiteral("יתרת פתיחה"), QStringLiteral("999.99"), QStringLiteral("0.00"),
     QStringLiteral("ש\"ח"), QStringLiteral("999.99"), QStringLiteral("C3"), QStringLiteral("0"),
     QStringLiteral("0"), QStringLiteral("0"), QStringLiteral("1")},
};

// One way to reach the fixture companies: the connection values and the
// company-directory text naming both companies.
struct Backend {
    QString server;
    QString uid;
    QString pwd;
    int type = 0;
    QString first;  // the first company alone
    QString second; // the second company alone
    QString noAccounts;
    QString dirs() const { return first + u';' + second; }
    QString connString(const QString& database) const {
        return BuildConnString(server, uid, pwd, database, type);
    }
};

// A port on 127.0.0.1 that takes connections into a full queue and never
// accepts them: a connection attempt there waits until its own time-out.
class SilentPort {
public:
    SilentPort() {
        listener_ = ::socket(AF_INET, SOCK_STREAM, 0);
        sockaddr_in address{};
        address.sin_family = AF_INET;
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        socklen_t length = sizeof address;
        if (listener_ < 0 ||
            ::bind(listener_, reinterpret_cast<sockaddr*>(&address), length) != 0 ||
            ::listen(listener_, 0) != 0 ||
            ::getsockname(listener_, reinterpret_cast<sockaddr*>(&address), &length) != 0)
            return;
        port_ = ntohs(address.sin_port);
        // A backlog of 0 still queues a connection or two; fill the queue so
        // that later attempts are left without an answer.
        for (int i = 0; i < 4; ++i) {
            const int client = ::socket(AF_INET, SOCK_STREAM, 0);
            ::fcntl(client, F_SETFL, O_NONBLOCK);
            ::connect(client, reinterpret_cast<const sockaddr*>(&address), sizeof address);
            fillers_.push_back(client);
        }
        QTest::qWait(200);
    }
    ~SilentPort() {
        for (const int client : fillers_)
            ::close(client);
        if (listener_ >= 0)
            ::close(listener_);
    }
    SilentPort(const SilentPort&) = delete;
    SilentPort& operator=(const SilentPort&) = delete;
    quint16 port() const { return port_; }

private:
    int listener_ = -1;
    quint16 port_ = 0;
    std::vector<int> fillers_;
};

class TestServer : public QObject {
    Q_OBJECT

private:
    QTemporaryDir dir_;
    QString sqliteDir_;
    QByteArray serverPort_;
    host::MessageRecorder messages_;
    host::PageWindowRecorder windows_;
    std::unique_ptr<host::ScopedSeams> seams_;
    bool serverStopped_ = false;

    Backend sqlite() const {
        return {sqliteDir_,
                QString(),
                QString(),
                4,
                pgfixture::company1() + QStringLiteral(".db"),
                pgfixture::company2() + QStringLiteral(".db"),
                pgfixture::noAccounts() + QStringLiteral(".db")};
    }
    static Backend server(int type, const QString& pwd = pgfixture::password()) {
        return {type == 1 ? QStringLiteral("127.0.0.1") : QString(),
                pgfixture::user(),
                pwd,
                type,
                pgfixture::company1(),
                pgfixture::company2(),
                pgfixture::noAccounts()};
    }
    static void addTypes() {
        QTest::addColumn<int>("type");
        QTest::newRow("type 1, driver string") << 1;
        QTest::newRow("type 5, data source") << 5;
    }

    bool serverCtl(const QString& action) {
        const int code = QProcess::execute(QStringLiteral(ARDCARD_PG_CTL),
                                           {QStringLiteral(ARDCARD_PG_STATE), action});
        return code == 0;
    }
    void stopServer() {
        serverStopped_ = true;
        if (!serverCtl(QStringLiteral("stop")))
            qWarning("the server did not stop");
    }

    template <typename T> static T* child(const QWidget& parent, const QString& name) {
        auto* widget = parent.findChild<T*>(name);
        if (!widget)
            qFatal("no control %s", qPrintable(name));
        return widget;
    }
    static QStringList boxTexts(const Card& card) {
        QStringList texts;
        for (const QString& name : kBoxes)
            texts << child<QLineEdit>(card, name)->text();
        return texts;
    }
    static bool outputsEnabled(const Card& card) {
        return child<QPushButton>(card, QStringLiteral("CmdGraph"))->isEnabled() &&
               child<QPushButton>(card, QStringLiteral("ExcelButt"))->isEnabled() &&
               child<QPushButton>(card, QStringLiteral("PrintButt"))->isEnabled();
    }
    static QList<QStringList> gridRows(const Card& card) {
        QList<QStringList> rows;
        const LedgerModel& ledger = card.ledger();
        for (int r = 1; r <= ledger.gridRowCount() - 2; ++r) {
            QStringList cells;
            for (int c = 0; c < LedgerModel::kColumns; ++c)
                cells << ledger.cellText(r, c);
            rows << cells;
        }
        return rows;
    }
    static void click(const Card& card, const QString& button) {
        QTest::mouseClick(child<QPushButton>(card, button), Qt::LeftButton);
    }

    // A shown card on `b` with the first company's details read, as a
    // placing would leave it.
    std::unique_ptr<Card> cardOn(const Backend& b) {
        moduleState() = ModuleState{};
        auto card = std::make_unique<Card>();
        // After the card has loaded the stored values at its creation.
        moduleState().conn = ConnValues{b.server, b.uid, b.pwd, b.dirs(), b.type};
        card->setCompDir(b.dirs());
        card->resize(900, 640);
        card->show();
        if (!QTest::qWaitForWindowExposed(card.get()))
            qWarning("card not exposed");
        return card;
    }
    static void showAccount(Card& card, const Backend& b, const QString& key) {
        card.ShowAccount(b.server, b.uid, b.pwd, b.type, b.dirs(), key);
    }

    // The lookup steps a clerk takes, each as the boxes and the account's ID.
    QStringList lookupWalk(const Backend& b) {
        auto card = cardOn(b);
        QStringList seen;
        const auto note = [&](const char* step) {
            seen << QString::fromLatin1(step) + QStringLiteral(": ") +
                        QString::number(card->PubACTLocation) + QStringLiteral(": ") +
                        boxTexts(*card).join(u'|');
        };
        const auto search = [&](const char* label, const char* box, const QString& value) {
            child<QLineEdit>(*card, QString::fromLatin1(box))->setText(value);
            QTest::mouseDClick(child<QLabel>(*card, QString::fromLatin1(label)), Qt::LeftButton);
        };
        showAccount(*card, b, QStringLiteral("1001"));
        note("show 1001");
        // Next keeps the key search of ShowAccount: no second 1001.
        click(*card, QStringLiteral("NextButt"));
        note("next after show");
        click(*card, QStringLiteral("FirstButt"));
        note("first");
        for (const char* step : {"next 1", "next 2", "next 3", "next 4", "next 5", "next 6"}) {
            click(*card, QStringLiteral("NextButt"));
            note(step);
        }
        click(*card, QStringLiteral("FirstButt"));
        note("first again");
        click(*card, QStringLiteral("PrevButt"));
        note("previous on first");
        click(*card, QStringLiteral("LastButt"));
        note("last");
        search("Label2", "txtAccountName", QStringLiteral(" כהן "));
        note("name search");
        click(*card, QStringLiteral("NextButt"));
        note("next match");
        search("Label8", "txtTelephone", QStringLiteral("2222"));
        note("telephone search");
        search("Label7", "txtAddress", QStringLiteral("כהן"));
        note("address search");
        search("LblDetails", "txtDetails", QStringLiteral("ספק"));
        note("details search");
        search("Label1", "txtAccountKey", QStringLiteral("'10\"04'"));
        note("key search, hidden");
        search("Label2", "txtAccountName", QStringLiteral("O'Brien"));
        note("name with a quote");
        return seen;
    }

    // Bytes of an output file with today's date in a fixed form.
    static QByteArray pageBytes(const QString& path) {
        QFile file(path);
        if (!file.open(QIODevice::ReadOnly))
            return "missing: " + path.toUtf8();
        QByteArray bytes = file.readAll();
        bytes.replace(QDate::currentDate().toString(QStringLiteral("dd/MM/yyyy")).toLatin1(),
                      "DD/MM/YYYY");
        return bytes;
    }
    static QString tempFile(const QString& name) {
        return qEnvironmentVariable("Temp") + u'/' + name;
    }

    // Every output of a fetch of 1001 over both companies: grid, statement,
    // CSV and its page, graph, account page through the key image.
    QList<QByteArray> outputs(const Backend& b) {
        QList<QByteArray> out;
        // The statement names each company by its entry in the directory
        // text, which for the files carries the file name's ending.
        const auto sameNames = [&](QByteArray bytes) {
            return bytes.replace(b.first.toUtf8(), pgfixture::company1().toUtf8())
                .replace(b.second.toUtf8(), pgfixture::company2().toUtf8());
        };
        auto card = cardOn(b);
        showAccount(*card, b, QStringLiteral("1001"));
        for (const QStringList& row : gridRows(*card))
            out << row.join(u'\t').toUtf8();
        for (const char* button : {"PrintButt", "ExcelButt", "CmdGraph"})
            click(*card, QString::fromLatin1(button));
        for (const char* name : {"vlprint.htm", "vltrans1.csv", "vltrans1.htm", "vtransg.htm"})
            out << sameNames(pageBytes(tempFile(QString::fromLatin1(name))));
        QTest::mouseDClick(child<QLabel>(*card, QStringLiteral("imgAccKey")), Qt::LeftButton);
        out << pageBytes(tempFile(QStringLiteral("vlicrd1.htm")));
        return out;
    }

    static QStringList lines(const QByteArray& bytes) {
        return QString::fromLatin1(bytes).split(QStringLiteral("\r\n"));
    }

private Q_SLOTS:
    void initTestCase();
    void init();
    void cleanup();
    void cleanupTestCase();

    void lookupAndNavigation_data() { addTypes(); }
    void lookupAndNavigation();
    void searchLetterCase_data() { addTypes(); }
    void searchLetterCase();
    void fetchBothCompanies_data() { addTypes(); }
    void fetchBothCompanies();
    void outputsMatch_data() { addTypes(); }
    void outputsMatch();
    void infoPages_data();
    void infoPages();
    void dialogCheck_data();
    void dialogCheck();
    void checkConnection_data() { addTypes(); }
    void checkConnection();

    void serverStoppedBeforeLookup_data() { addTypes(); }
    void serverStoppedBeforeLookup();
    void serverStoppedBetweenCompanies_data() { addTypes(); }
    void serverStoppedBetweenCompanies();
    void wrongPassword_data() { addTypes(); }
    void wrongPassword();
    void databaseWithoutAccounts_data() { addTypes(); }
    void databaseWithoutAccounts();
    void connectionTimeOut();
};

void TestServer::initTestCase() {
    QVERIFY(dir_.isValid());
    fixture::isolate(dir_);
    QSettings state(QStringLiteral(ARDCARD_PG_STATE), QSettings::IniFormat);
    const QString run = state.value(QStringLiteral("PG_RUN")).toString();
    serverPort_ = state.value(QStringLiteral("PG_PORT")).toString().toLatin1();
    QVERIFY2(!run.isEmpty() && !serverPort_.isEmpty(),
             "no test server: tests/pg/start.sh runs before this test (ctest -R test_server)");
    // The private ODBC configuration of the run, and the server's port for
    // the driver string, which names none.
    qputenv("ODBCSYSINI", QFile::encodeName(run));
    qputenv("ODBCINI", QFile::encodeName(run + QStringLiteral("/odbc.ini")));
    qputenv("PGPORT", serverPort_);

    sqliteDir_ = dir_.path() + QStringLiteral("/sqlite");
    QVERIFY(QDir().mkpath(sqliteDir_));
    try {
        pgfixture::buildSqliteCompanies(sqliteDir_);
    } catch (const Failure& failure) {
        QFAIL(qPrintable(failure.description()));
    }
    seams_ = std::make_unique<host::ScopedSeams>(&messages_, &windows_);
}

void TestServer::init() {
    fixture::resetSettings(dir_);
    moduleState() = ModuleState{};
    messages_.clear();
    windows_.clear();
}

void TestServer::cleanup() {
    // No message of these tests ever shows a password.
    for (const host::Message& m : messages_.messages()) {
        for (const QString& password : {pgfixture::password(), kWrongPassword}) {
            QVERIFY2(!m.text.contains(password) && !m.title.contains(password), qPrintable(m.text));
        }
    }
    if (serverStopped_) {
        serverStopped_ = false;
        QVERIFY2(serverCtl(QStringLiteral("start")), "the server did not start again");
    }
    qputenv("PGPORT", serverPort_);
}

void TestServer::cleanupTestCase() {
    seams_.reset();
}

// ---- the same card on both engines ----------------------------------------

void TestServer::lookupAndNavigation() {
    QFETCH(int, type);
    const QStringList onServer = lookupWalk(server(type));
    const QStringList onFile = lookupWalk(sqlite());
    QCOMPARE(onServer, onFile);
    QVERIFY(messages_.messages().isEmpty());

    const auto expected = [](const char* step, int id, const QStringList& boxes) {
        return QString::fromLatin1(step) + QStringLiteral(": ") + QString::number(id) +
               QStringLiteral(": ") + boxes.join(u'|');
    };
    const QString hidden = QStringLiteral("חשבון חסוי");
    QCOMPARE(onServer.size(), 19);
    QCOMPARE(onServer.at(0), expected("show 1001", 1, kAccount1001));
    QCOMPARE(onServer.at(1), expected("next after show", 0, QStringList(12)));
    QCOMPARE(onServer.at(2), expected("first", 1, kAccount1001));
    // Next skips the Dumi row (ID 3) and masks the hidden account (ID 4).
    QCOMPARE(onServer.at(4),
             expected("next 2", 4, {hidden, hidden, {}, {}, {}, {}, {}, {}, {}, {}, {}, {}}));
    QCOMPARE(onServer.at(5), expected("next 3", 5,
                                      {QStringLiteral("1005"),
                                       QStringLiteral("דני כהן"),
                                       {},
                                       {},
                                       {},
                                       {},
                                       {},
                                       {},
                                       {},
                                       {},
                                       {},
                                       {}}));
    // Past the last account nothing is shown.
    QCOMPARE(onServer.at(8), expected("next 6", 0, QStringList(12)));
    QCOMPARE(onServer.at(10), expected("previous on first", 0, QStringList(12)));
    QVERIFY(onServer.at(11).startsWith(QStringLiteral("last: 7: 5000|קופה|")));
    QCOMPARE(onServer.at(12), expected("name search", 1, kAccount1001));
    QVERIFY(onServer.at(13).startsWith(QStringLiteral("next match: 5: 1005|")));
    QVERIFY(onServer.at(14).startsWith(QStringLiteral("telephone search: 2: 1002|")));
    QVERIFY(onServer.at(15).startsWith(QStringLiteral("address search: 6: 4000|")));
    QVERIFY(onServer.at(16).startsWith(QStringLiteral("details search: 2: 1002|")));
    QVERIFY(onServer.at(17).startsWith(QStringLiteral("key search, hidden: 4: חשבון חסוי|")));
    QVERIFY(onServer.at(18).startsWith(QStringLiteral("name with a quote: 2: 1002|O'Brien Ltd|")));
}

// The one difference between the engines: the files compare Latin letters
// in a Like pattern without regard to case, the server with it (the schema
// keeps the server's own collation), so a name typed in small letters finds
// an account in the file and none on the server.
void TestServer::searchLetterCase() {
    QFETCH(int, type);
    const auto nameSearch = [&](const Backend& b) {
        auto card = cardOn(b);
        child<QLineEdit>(*card, QStringLiteral("txtAccountName"))
            ->setText(QStringLiteral("o'brien"));
        QTest::mouseDClick(child<QLabel>(*card, QStringLiteral("Label2")), Qt::LeftButton);
        return card->PubACTLocation;
    };
    QCOMPARE(nameSearch(sqlite()), 2);
    QCOMPARE(nameSearch(server(type)), 0);
    QVERIFY(messages_.messages().isEmpty());
}

void TestServer::fetchBothCompanies() {
    QFETCH(int, type);
    const Backend b = server(type);
    auto card = cardOn(b);
    showAccount(*card, b, QStringLiteral("1001"));
    QVERIFY(messages_.messages().isEmpty());
    QCOMPARE(gridRows(*card), kLedger1001);
    QCOMPARE(int(card->ledger().rowDetail(2).CompIndex), 1);
    // A credit line's counter account is the transaction's credit key.
    QCOMPARE(card->ledger().rowDetail(2).CounterKey, QStringLiteral("1001"));
    QCOMPARE(int(card->ledger().rowDetail(4).CompIndex), 2);
    QVERIFY(outputsEnabled(*card));

    auto fileCard = cardOn(sqlite());
    showAccount(*fileCard, sqlite(), QStringLiteral("1001"));
    QCOMPARE(gridRows(*card), gridRows(*fileCard));
}

void TestServer::outputsMatch() {
    QFETCH(int, type);
    const QList<QByteArray> onServer = outputs(server(type));
    const QList<QByteArray> onFile = outputs(sqlite());
    QCOMPARE(onServer.size(), onFile.size());
    for (qsizetype i = 0; i < onServer.size(); ++i) {
        if (onServer.at(i) != onFile.at(i)) {
            const QStringList a = lines(onServer.at(i));
            const QStringList b = lines(onFile.at(i));
            for (qsizetype l = 0; l < std::min(a.size(), b.size()); ++l) {
                if (a.at(l) != b.at(l))
                    qWarning("output %d line %d:\n server: %s\n file:   %s", int(i), int(l),
                             a.at(l).toLatin1().constData(), b.at(l).toLatin1().constData());
            }
            QFAIL(qPrintable(QStringLiteral("output %1 differs").arg(i)));
        }
    }
    QVERIFY(messages_.messages().isEmpty());
}

void TestServer::infoPages_data() {
    QTest::addColumn<int>("type");
    QTest::addColumn<QString>("page"); // account, item, doctypes
    QTest::addColumn<QString>("key");
    for (const int type : {1, 5}) {
        const QByteArray t = QByteArray::number(type);
        QTest::newRow("account 1001, type " + t) << type << "account"
                                                 << "1001";
        QTest::newRow("account with a quote, type " + t) << type << "account"
                                                         << "O'B";
        QTest::newRow("item P100, type " + t) << type << "item"
                                              << "P100";
        QTest::newRow("item P200, type " + t) << type << "item"
                                              << " P200 ";
        QTest::newRow("document types, type " + t) << type << "doctypes" << QString();
    }
}

void TestServer::infoPages() {
    QFETCH(int, type);
    QFETCH(QString, page);
    QFETCH(QString, key);
    const auto write = [&](const Backend& b, const QString& file) {
        Ard7Info info;
        const QString path = dir_.path() + u'/' + file;
        const QString conn = b.connString(b.first);
        try {
            if (page == QStringLiteral("account"))
                info.CreateAccountHTML(path, key.trimmed(), conn, b.type);
            else if (page == QStringLiteral("item"))
                info.CreateItemHTML(path, key.trimmed(), conn, b.type);
            else
                info.CreateDocTypeHTML(path, conn);
        } catch (const Failure& failure) {
            return QByteArray("failure: ") + failure.description().toUtf8();
        }
        return pageBytes(path);
    };
    const QByteArray onServer = write(server(type), QStringLiteral("server.htm"));
    const QByteArray onFile = write(sqlite(), QStringLiteral("file.htm"));
    QVERIFY2(!onServer.startsWith("failure"), onServer.constData());
    QCOMPARE(onServer, onFile);
}

void TestServer::dialogCheck_data() {
    QTest::addColumn<int>("type");
    QTest::addColumn<QString>("databases"); // on the server; ".db" added for the file
    QTest::addColumn<bool>("passes");
    for (const int type : {1, 5}) {
        const QByteArray t = QByteArray::number(type);
        QTest::newRow("both companies, type " + t)
            << type << QStringLiteral("ardco1;ardco2") << true;
        QTest::newRow("second without accounts, type " + t)
            << type << QStringLiteral("ardco1;ardnoacc") << false;
    }
}

void TestServer::dialogCheck() {
    QFETCH(int, type);
    QFETCH(QString, databases);
    QFETCH(bool, passes);
    const Backend b = server(type);
    frmAConn dialog;
    dialog.show();
    dialog.txtConnServer->setText(b.server);
    dialog.txtConnUID->setText(b.uid);
    dialog.txtConnPWD->setText(b.pwd);
    dialog.txtConnDatabase->setText(databases);
    dialog.CmbConnType->setCurrentIndex(type - 1);
    QTest::mouseClick(dialog.CmdCheck, Qt::LeftButton);
    if (passes) {
        QCOMPARE(dialog.LblMsg->text(), QStringLiteral("הבדיקה הסתיימה בהצלחה"));
        QVERIFY(messages_.messages().isEmpty());
        return;
    }
    QCOMPARE(dialog.LblMsg->text(), QStringLiteral("הבדיקה לא הסתיימה בהצלחה"));
    QCOMPARE(messages_.messages().size(), 1);
    const host::Message& m = messages_.messages().first();
    QCOMPARE(m.title, kFailureTitle);
    QCOMPARE(m.icon, host::MessageIcon::Critical);
    // The server's own words: the relation "accounts" does not exist.
    QVERIFY2(m.text.contains(QStringLiteral("accounts")), qPrintable(m.text));
}

void TestServer::checkConnection() {
    QFETCH(int, type);
    const Backend b = server(type);
    moduleState().conn = ConnValues{b.server, b.uid, b.pwd, b.first, b.type};
    Ard7Info info;
    QVERIFY(info.CheckConnArd7());
    QVERIFY(info.CheckConnArd7(b.second));
    // No document type 1 in a database without it still answers.
    QVERIFY(info.CheckConnArd7(b.noAccounts));
    QVERIFY(messages_.messages().isEmpty());
}

// ---- faults on the server side ---------------------------------------------

void TestServer::serverStoppedBeforeLookup() {
    QFETCH(int, type);
    const Backend b = server(type);
    auto card = cardOn(b);
    showAccount(*card, b, QStringLiteral("1001"));
    QCOMPARE(boxTexts(*card), kAccount1001);
    stopServer();
    click(*card, QStringLiteral("NextButt"));
    QCOMPARE(messages_.messages().size(), 1);
    const host::Message& m = messages_.messages().first();
    QCOMPARE(m.title, kLookupTitle);
    QCOMPARE(m.icon, host::MessageIcon::Critical);
    QVERIFY(!m.text.isEmpty());
    QCOMPARE(boxTexts(*card), kAccount1001);
    QCOMPARE(card->PubACTLocation, 1);
}

void TestServer::serverStoppedBetweenCompanies() {
    QFETCH(int, type);
    const Backend b = server(type);
    auto card = cardOn(b);
    showAccount(*card, b, QStringLiteral("1001"));
    QCOMPARE(gridRows(*card), kLedger1001);
    messages_.clear();

    // The first company's rows reach the grid inside its read; the server
    // goes down at the yield that follows, before the second company.
    bool armed = false;
    const QMetaObject::Connection hook =
        connect(&card->ledger(), &QAbstractItemModel::rowsInserted, this, [&] {
            if (armed)
                return;
            armed = true;
            QTimer::singleShot(0, this, &TestServer::stopServer);
        });
    click(*card, QStringLiteral("ShowTransButt"));
    disconnect(hook);
    QVERIFY(serverStopped_);

    QCOMPARE(gridRows(*card), kLedger1001.mid(0, 3));
    QCOMPARE(messages_.messages().size(), 1);
    const host::Message& m = messages_.messages().first();
    QCOMPARE(m.title, kFailureTitle);
    QCOMPARE(m.icon, host::MessageIcon::Information);
    QVERIFY(!m.text.isEmpty());
    QVERIFY(outputsEnabled(*card));
}

void TestServer::wrongPassword() {
    QFETCH(int, type);
    const Backend b = server(type, kWrongPassword);
    auto card = cardOn(b);
    showAccount(*card, b, QStringLiteral("1001"));
    // The lookup fails with its own title, then each company's read with
    // its own; the fetch still ends with the outputs usable.
    QCOMPARE(messages_.messages().size(), 3);
    QCOMPARE(messages_.messages().at(0).title, kLookupTitle);
    QCOMPARE(messages_.messages().at(0).icon, host::MessageIcon::Critical);
    for (int i = 1; i < 3; ++i) {
        QCOMPARE(messages_.messages().at(i).title, kFailureTitle);
        QCOMPARE(messages_.messages().at(i).icon, host::MessageIcon::Information);
    }
    for (const host::Message& m : messages_.messages())
        QVERIFY2(m.text.contains(QStringLiteral("password authentication failed")),
                 qPrintable(m.text));
    QCOMPARE(boxTexts(*card),
             (QStringList{QStringLiteral("1001"), {}, {}, {}, {}, {}, {}, {}, {}, {}, {}, {}}));
    QCOMPARE(card->ledger().dataRowCount(), 0);
    QVERIFY(outputsEnabled(*card));

    Ard7Info info;
    QVERIFY(!info.CheckConnArd7());
}

void TestServer::databaseWithoutAccounts() {
    QFETCH(int, type);
    Backend b = server(type);
    b.first = b.noAccounts;
    auto card = cardOn(b);
    showAccount(*card, b, QStringLiteral("1001"));
    // The lookup fails on the missing table; the fetch reads no account
    // there and the second company's line.
    QCOMPARE(messages_.messages().size(), 1);
    const host::Message& m = messages_.messages().first();
    QCOMPARE(m.title, kLookupTitle);
    QCOMPARE(m.icon, host::MessageIcon::Critical);
    QVERIFY2(m.text.contains(QStringLiteral("accounts")), qPrintable(m.text));
    QCOMPARE(gridRows(*card), kLedger1001.mid(3));
    QVERIFY(outputsEnabled(*card));
}

void TestServer::connectionTimeOut() {
    SilentPort silent;
    QVERIFY(silent.port() != 0);
    moduleState().conn = ConnValues{QStringLiteral("127.0.0.1"), pgfixture::user(),
                                    pgfixture::password(), pgfixture::company1(), 1};
    qputenv("PGPORT", QByteArray::number(silent.port()));
    Ard7Info info;
    QElapsedTimer timer;
    timer.start();
    QVERIFY(!info.CheckConnArd7());
    QVERIFY2(timer.elapsed() < 20000, qPrintable(QString::number(timer.elapsed())));
    QVERIFY(messages_.messages().isEmpty());
}

} // namespace

QTEST_MAIN(TestServer)
#include "test_server.moc"
