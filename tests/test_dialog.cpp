// The connection settings dialog on the offscreen platform: loading the
// values in use, OK, Cancel, and the connection check against real SQLite
// company files.

#include "card_fixture.h"
#include "common/module_state.h"
#include "connection/conn_dialog.h"
#include "connection/settings_store.h"
#include "host/seams.h"

#include <QComboBox>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTest>

using namespace ardcard;

namespace {

const QString kAdvice = QStringLiteral("מומלץ לבצע בדיקה לאחר שינוי ערכי ההתחברות!");
const QString kSuccess = QStringLiteral("הבדיקה הסתיימה בהצלחה");
const QString kFailure = QStringLiteral("הבדיקה לא הסתיימה בהצלחה");

QString stored(const char* key) {
    return ReadSetting(kRegApp, kRegSection, QString::fromLatin1(key), QStringLiteral("<none>"));
}

class TestDialog : public QObject {
    Q_OBJECT

private:
    QTemporaryDir dir_;
    host::MessageRecorder messages_;
    host::PageWindowRecorder windows_;
    std::unique_ptr<host::ScopedSeams> seams_;

    // The values in use: the test directory as server, Jet 4.0.
    void useValues(const QString& database, int type = 4) {
        moduleState().conn =
            ConnValues{dir_.path(), QStringLiteral("sa"), QStringLiteral("pw"), database, type};
    }

private Q_SLOTS:
    void initTestCase();
    void init();
    void cleanupTestCase();

    void controls();
    void loadsValuesInUse_data();
    void loadsValuesInUse();
    void okSavesAndSetsValues();
    void okWithNoTypeStoresMinusOne();
    void okSaveFailureKeepsDialogOpen();
    void cancelChangesNothing();
    void reopenedShowsValuesInUse();
    void check_data();
    void check();
    void checkUsesScreenValues();
};

void TestDialog::initTestCase() {
    QVERIFY(dir_.isValid());
    fixture::isolate(dir_);
    seams_ = std::make_unique<host::ScopedSeams>(&messages_, &windows_);
    QVERIFY(fixture::createDatabase(
        dir_.path(), QStringLiteral("co1.db"),
        {QStringLiteral("INSERT INTO Accounts (ID, AccountKey) VALUES (1, '1001')")}));
    QVERIFY(fixture::createDatabase(dir_.path(), QStringLiteral("co2.db"), {}));
    QVERIFY(fixture::createDatabase(dir_.path(), QStringLiteral("noaccounts.db"),
                                    {QStringLiteral("DROP TABLE Accounts")}));
}

void TestDialog::init() {
    fixture::resetSettings(dir_);
    moduleState() = ModuleState{};
    messages_.clear();
}

void TestDialog::cleanupTestCase() {
    seams_.reset();
}

void TestDialog::controls() {
    frmAConn dialog;
    QCOMPARE(dialog.windowTitle(), QStringLiteral("הגדרות התחברות לארדקו חלונות"));
    QCOMPARE(dialog.layoutDirection(), Qt::RightToLeft);
    QVERIFY(dialog.isModal());
    QCOMPARE(dialog.findChild<QGroupBox*>(QStringLiteral("fraStep3"))->title(),
             QStringLiteral("ערכי התחברות"));
    const QList<QLabel*> captions = dialog.findChildren<QLabel*>(QStringLiteral("lblStep3"));
    QCOMPARE(captions.size(), 5);
    QStringList texts;
    for (QLabel* caption : dialog.lblStep3)
        texts << caption->text();
    QCOMPARE(texts, (QStringList{QStringLiteral("שרת נתונים:"), QStringLiteral("משתמש:"),
                                 QStringLiteral("סיסמה:"), QStringLiteral("בסיסי נתונים:"),
                                 QStringLiteral("סוג בסיס הנתונים:")}));
    QCOMPARE(dialog.lblStep3.at(2)->buddy(), dialog.txtConnPWD);
    QCOMPARE(dialog.txtConnPWD->echoMode(), QLineEdit::Password);
    QStringList items;
    for (int i = 0; i < dialog.CmbConnType->count(); ++i)
        items << dialog.CmbConnType->itemText(i);
    QCOMPARE(items, (QStringList{QStringLiteral("MS-SQL Server Via ODBC"),
                                 QStringLiteral("MS-SQL Server Via OLE-DB"),
                                 QStringLiteral("DAO 3.5 Via OLE-DB"),
                                 QStringLiteral("DAO 4.0 Via OLE-DB"), QStringLiteral("ODBC DSN"),
                                 QStringLiteral("ODBC Driver for Access")}));
    QCOMPARE(dialog.cmdOK->text(), QStringLiteral("אישור"));
    QCOMPARE(dialog.CmdCheck->text(), QStringLiteral("בדיקה"));
    QCOMPARE(dialog.cmdCancel->text(), QStringLiteral("ביטול"));
    QCOMPARE(dialog.LblMsg->text(), kAdvice);
    for (const char* name : {"txtConnServer", "txtConnUID", "txtConnPWD", "txtConnDatabase"})
        QVERIFY(dialog.findChild<QLineEdit*>(QString::fromLatin1(name)));
    QVERIFY(dialog.findChild<QComboBox*>(QStringLiteral("CmbConnType")));

    // Buttons from right to left: OK, check, cancel.
    dialog.show();
    QVERIFY(QTest::qWaitForWindowExposed(&dialog));
    QVERIFY(dialog.cmdOK->x() > dialog.CmdCheck->x());
    QVERIFY(dialog.CmdCheck->x() > dialog.cmdCancel->x());
}

void TestDialog::loadsValuesInUse_data() {
    QTest::addColumn<int>("type");
    QTest::addColumn<int>("position");
    QTest::newRow("1") << 1 << 0;
    QTest::newRow("4") << 4 << 3;
    QTest::newRow("6") << 6 << 5;
    QTest::newRow("0: none") << 0 << -1;
    QTest::newRow("7: none") << 7 << -1;
    QTest::newRow("-3: none") << -3 << -1;
}

void TestDialog::loadsValuesInUse() {
    QFETCH(int, type);
    QFETCH(int, position);
    useValues(QStringLiteral("co1.db;co2.db"), type);
    frmAConn dialog;
    QCOMPARE(dialog.txtConnServer->text(), dir_.path());
    QCOMPARE(dialog.txtConnUID->text(), QStringLiteral("sa"));
    QCOMPARE(dialog.txtConnPWD->text(), QStringLiteral("pw"));
    QCOMPARE(dialog.txtConnDatabase->text(), QStringLiteral("co1.db;co2.db"));
    QCOMPARE(dialog.CmbConnType->currentIndex(), position);
}

void TestDialog::okSavesAndSetsValues() {
    useValues(QStringLiteral("co1.db"));
    frmAConn dialog;
    dialog.show();
    dialog.txtConnServer->setText(QStringLiteral("srv"));
    dialog.txtConnUID->setText(QStringLiteral("clerk"));
    dialog.txtConnPWD->setText(QStringLiteral("a;b"));
    dialog.txtConnDatabase->setText(QStringLiteral("x.db"));
    dialog.CmbConnType->setCurrentIndex(1);
    QTest::mouseClick(dialog.cmdOK, Qt::LeftButton);
    QCOMPARE(dialog.result(), int(QDialog::Accepted));
    QVERIFY(!dialog.isVisible());
    const ConnValues& c = moduleState().conn;
    QCOMPARE(c.ConnServer, QStringLiteral("srv"));
    QCOMPARE(c.ConnUID, QStringLiteral("clerk"));
    QCOMPARE(c.ConnPWD, QStringLiteral("a;b"));
    QCOMPARE(c.ConnDataBase, QStringLiteral("x.db"));
    QCOMPARE(c.ConnType, 2);
    QCOMPARE(stored("ConnServer"), QStringLiteral("srv"));
    QCOMPARE(stored("ConnUID"), QStringLiteral("clerk"));
    QCOMPARE(stored("ConnPWD"), QStringLiteral("a;b"));
    QCOMPARE(stored("ConnDataBase"), QStringLiteral("x.db"));
    QCOMPARE(stored("ConnType"), QStringLiteral("1"));
    QVERIFY(messages_.messages().isEmpty());

    // Loading back gives the same type.
    moduleState() = ModuleState{};
    ReadConnParams();
    QCOMPARE(moduleState().conn.ConnType, 2);
}

void TestDialog::okWithNoTypeStoresMinusOne() {
    useValues(QStringLiteral("co1.db"), 0);
    frmAConn dialog;
    dialog.show();
    QCOMPARE(dialog.CmbConnType->currentIndex(), -1);
    QTest::mouseClick(dialog.cmdOK, Qt::LeftButton);
    QCOMPARE(moduleState().conn.ConnType, 0);
    QCOMPARE(stored("ConnType"), QStringLiteral("-1"));
}

void TestDialog::okSaveFailureKeepsDialogOpen() {
    QVERIFY(QDir().mkpath(fixture::settingsFile(dir_)));
    useValues(QStringLiteral("co1.db"));
    frmAConn dialog;
    dialog.show();
    QVERIFY(QTest::qWaitForWindowExposed(&dialog));
    dialog.txtConnDatabase->setText(QStringLiteral("x.db"));
    QTest::mouseClick(dialog.cmdOK, Qt::LeftButton);
    QVERIFY(dialog.isVisible());
    QCOMPARE(messages_.messages().size(), 1);
    QCOMPARE(messages_.messages().first().title, QStringLiteral("תקלה"));
    QCOMPARE(messages_.messages().first().icon, host::MessageIcon::Critical);
    QVERIFY(
        messages_.messages().first().text.startsWith(QStringLiteral("לא ניתן לשמור את ההגדרות")));
    // The values are in use all the same.
    QCOMPARE(moduleState().conn.ConnDataBase, QStringLiteral("x.db"));
}

void TestDialog::cancelChangesNothing() {
    useValues(QStringLiteral("co1.db"));
    frmAConn dialog;
    dialog.show();
    dialog.txtConnServer->setText(QStringLiteral("srv"));
    dialog.txtConnDatabase->setText(QStringLiteral("x.db"));
    dialog.CmbConnType->setCurrentIndex(0);
    QTest::mouseClick(dialog.cmdCancel, Qt::LeftButton);
    QCOMPARE(dialog.result(), int(QDialog::Rejected));
    QVERIFY(!dialog.isVisible());
    const ConnValues& c = moduleState().conn;
    QCOMPARE(c.ConnServer, dir_.path());
    QCOMPARE(c.ConnDataBase, QStringLiteral("co1.db"));
    QCOMPARE(c.ConnType, 4);
    QCOMPARE(stored("ConnServer"), QStringLiteral("<none>"));
    QCOMPARE(stored("ConnDataBase"), QStringLiteral("<none>"));
    QVERIFY(!QFile::exists(fixture::settingsFile(dir_)));
}

void TestDialog::reopenedShowsValuesInUse() {
    useValues(QStringLiteral("co1.db"));
    frmAConn dialog;
    dialog.show();
    dialog.txtConnDatabase->setText(QStringLiteral("edited.db"));
    QTest::mouseClick(dialog.cmdCancel, Qt::LeftButton);
    moduleState().conn.ConnType = 3;
    dialog.show();
    QCOMPARE(dialog.txtConnDatabase->text(), QStringLiteral("co1.db"));
    QCOMPARE(dialog.CmbConnType->currentIndex(), 2);
}

void TestDialog::check_data() {
    QTest::addColumn<QString>("databases");
    QTest::addColumn<int>("position");
    QTest::addColumn<bool>("passes");
    QTest::addColumn<QString>("failure"); // a piece of the failure's description
    QTest::newRow("one") << QStringLiteral("co1.db") << 3 << true << QString();
    QTest::newRow("two") << QStringLiteral("co1.db;co2.db") << 3 << true << QString();
    QTest::newRow("empty field") << QString() << 3 << true << QString();
    QTest::newRow("empty field, no type") << QString() << -1 << true << QString();
    QTest::newRow("jet 3.51") << QStringLiteral("co2.db") << 2 << true << QString();
    QTest::newRow("missing file") << QStringLiteral("missing.db") << 3 << false
                                  << QStringLiteral("missing.db");
    QTest::newRow("no accounts table") << QStringLiteral("noaccounts.db") << 3 << false
                                       << QStringLiteral("no such table: Accounts");
    QTest::newRow("second fails") << QStringLiteral("co1.db;missing.db") << 3 << false
                                  << QStringLiteral("missing.db");
    // The first failure stops the check: the second piece is not tried.
    QTest::newRow("first fails, second not tried")
        << QStringLiteral("noaccounts.db;missing.db") << 3 << false
        << QStringLiteral("no such table: Accounts");
    QTest::newRow("comma is no separator here")
        << QStringLiteral("co1.db,co2.db") << 3 << false << QStringLiteral("co1.db,co2.db");
    QTest::newRow("trailing separator tests an empty database")
        << QStringLiteral("co1.db;") << 3 << false << QString();
    QTest::newRow("no type selected") << QStringLiteral("co1.db") << -1 << false << QString();
}

void TestDialog::check() {
    QFETCH(QString, databases);
    QFETCH(int, position);
    QFETCH(bool, passes);
    QFETCH(QString, failure);
    frmAConn dialog;
    dialog.show();
    dialog.txtConnServer->setText(dir_.path());
    dialog.txtConnDatabase->setText(databases);
    dialog.CmbConnType->setCurrentIndex(position);
    QTest::mouseClick(dialog.CmdCheck, Qt::LeftButton);
    QVERIFY(dialog.isVisible());
    if (passes) {
        QCOMPARE(dialog.LblMsg->text(), kSuccess);
        QVERIFY(messages_.messages().isEmpty());
        return;
    }
    QCOMPARE(dialog.LblMsg->text(), kFailure);
    QCOMPARE(messages_.messages().size(), 1);
    const host::Message& m = messages_.messages().first();
    QCOMPARE(m.title, QStringLiteral("תקלה"));
    QCOMPARE(m.icon, host::MessageIcon::Critical);
    QVERIFY(!m.text.isEmpty());
    QVERIFY2(m.text.contains(failure), qPrintable(m.text));
}

void TestDialog::checkUsesScreenValues() {
    // Values in use that cannot connect; the screen's can.
    moduleState().conn = ConnValues{QStringLiteral("nowhere"), QString(), QString(),
                                    QStringLiteral("missing.db"), 1};
    frmAConn dialog;
    dialog.show();
    dialog.txtConnServer->setText(dir_.path() + u'/');
    dialog.txtConnDatabase->setText(QStringLiteral("co1.db"));
    dialog.CmbConnType->setCurrentIndex(5); // the Access ODBC string names the same file
    QTest::mouseClick(dialog.CmdCheck, Qt::LeftButton);
    QCOMPARE(dialog.LblMsg->text(), kSuccess);
    // Nothing saved, nothing taken into use.
    QCOMPARE(moduleState().conn.ConnServer, QStringLiteral("nowhere"));
    QCOMPARE(moduleState().conn.ConnType, 1);
    QVERIFY(!QFile::exists(fixture::settingsFile(dir_)));
}

} // namespace

QTEST_MAIN(TestDialog)
#include "test_dialog.moc"
