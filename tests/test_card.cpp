// The account card on the offscreen platform, against real SQLite company
// files: first placing, company directories, stored options, account lookup
// and navigation, company details, the connection picture.

#include "card/card.h"
#include "card_fixture.h"
#include "common/failure.h"
#include "common/module_state.h"
#include "connection/company_details.h"
#include "connection/conn_dialog.h"
#include "connection/settings_store.h"
#include "host/hosting_page.h"
#include "host/seams.h"

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSignalSpy>
#include <QTableView>
#include <QTest>
#include <QTimer>

using namespace ardcard;

namespace {

const QString kHidden = QStringLiteral("חשבון חסוי");

// The twelve account boxes in the order the lookup fills them.
const QStringList kBoxes = {
    QStringLiteral("txtAccountKey"), QStringLiteral("txtAccountName"),
    QStringLiteral("txtBalance"),    QStringLiteral("txtAddress"),
    QStringLiteral("txtCity"),       QStringLiteral("txtTelephone"),
    QStringLiteral("txtOblig"),      QStringLiteral("txtShipBalance"),
    QStringLiteral("txtDetails"),    QStringLiteral("txtZip"),
    QStringLiteral("txtDistrict"),   QStringLiteral("txtAgent"),
};

const QStringList kAccount1 = {
    QStringLiteral("1001"),     QStringLiteral("אבי כהן"), QStringLiteral("1,234.50"),
    QStringLiteral("הרצל 1"),   QStringLiteral("תל אביב"), QStringLiteral("03-1111111"),
    QStringLiteral("5,000.00"), QStringLiteral("0.00"),    QStringLiteral("לקוח ותיק"),
    QStringLiteral("61000"),    QStringLiteral("מרכז"),    QStringLiteral("7"),
};
const QStringList kAccount2 = {
    QStringLiteral("1002"),      QStringLiteral("O'Brien Ltd"), QStringLiteral("-250.75"),
    QStringLiteral("דרך הים 5"), QStringLiteral("חיפה"),        QStringLiteral("04-2222222"),
    QStringLiteral("0.00"),      QStringLiteral("1,500.00"),    QStringLiteral("ספק"),
    QStringLiteral("31000"),     QStringLiteral("צפון"),        QStringLiteral("3"),
};
const QStringList kAccount4Hidden = {kHidden,   kHidden,   QString(), QString(),
                                     QString(), QString(), QString(), QString(),
                                     QString(), QString(), QString(), QString()};
// Nulls everywhere but the key, the name and Dumi.
const QStringList kAccount5 = {QStringLiteral("1005"),
                               QStringLiteral("דני כהן"),
                               QString(),
                               QString(),
                               QString(),
                               QString(),
                               QString(),
                               QString(),
                               QString(),
                               QString(),
                               QString(),
                               QString()};
const QStringList kNoAccount = {QString(), QString(), QString(), QString(), QString(), QString(),
                                QString(), QString(), QString(), QString(), QString(), QString()};

class TestCard : public QObject {
    Q_OBJECT

private:
    QTemporaryDir dir_;
    host::MessageRecorder messages_;
    host::PageWindowRecorder windows_;
    std::unique_ptr<host::ScopedSeams> seams_;

    template <typename T> static T* child(const Card& card, const QString& name) {
        auto* widget = card.findChild<T*>(name);
        if (!widget)
            qFatal("no control %s", qPrintable(name));
        return widget;
    }
    static QLineEdit* box(const Card& card, const QString& name) {
        return child<QLineEdit>(card, name);
    }
    static QStringList boxTexts(const Card& card) {
        QStringList texts;
        for (const QString& name : kBoxes)
            texts << box(card, name)->text();
        return texts;
    }
    static bool outputsEnabled(const Card& card) {
        return child<QPushButton>(card, QStringLiteral("CmdGraph"))->isEnabled() &&
               child<QPushButton>(card, QStringLiteral("ExcelButt"))->isEnabled() &&
               child<QPushButton>(card, QStringLiteral("PrintButt"))->isEnabled();
    }
    static bool outputsDisabled(const Card& card) {
        return !child<QPushButton>(card, QStringLiteral("CmdGraph"))->isEnabled() &&
               !child<QPushButton>(card, QStringLiteral("ExcelButt"))->isEnabled() &&
               !child<QPushButton>(card, QStringLiteral("PrintButt"))->isEnabled();
    }

    void useCompany(const QString& database) {
        moduleState().conn = ConnValues{dir_.path(), QString(), QString(), database, 4};
    }

    // A shown card reading `database` through a Jet 4.0 connection string.
    std::unique_ptr<Card> placedCard(const QString& database = QStringLiteral("co1.db")) {
        auto card = std::make_unique<Card>();
        useCompany(database);
        card->setCompDir(database);
        card->resize(900, 640);
        card->show();
        if (!QTest::qWaitForWindowExposed(card.get()))
            qWarning("card not exposed");
        return card;
    }

    void click(const Card& card, const QString& button) {
        QTest::mouseClick(child<QPushButton>(card, button), Qt::LeftButton);
    }
    void doubleClick(const Card& card, const QString& label) {
        QTest::mouseDClick(child<QLabel>(card, label), Qt::LeftButton);
    }

private Q_SLOTS:
    void initTestCase();
    void init();
    void cleanupTestCase();

    void screenControls_data();
    void screenControls();
    void screenLayout();

    void placingAddress_data();
    void placingAddress();
    void placingValues_data();
    void placingValues();
    void placingOnlyOpen_data();
    void placingOnlyOpen();
    void placingStoredOptionsWin();
    void placingAccountWithQuotes();
    void placingAccountWithoutServer();
    void placingEmptyCompanyList();

    void typingCompanyPath();
    void focusOutSplits();

    void optionsRoundTrip_data();
    void optionsRoundTrip();
    void optionsMissingCompanyDir();
    void optionsOtherActions_data();
    void optionsOtherActions();
    void optionsSaveFailureShown();

    void navigationSteps();
    void nextPastLast();
    void previousOnFirst();
    void lastSkipsDumi();
    void searches_data();
    void searches();
    void searchThenNextThenPrevious();
    void searchValueTrimmed();
    void hiddenAccountsIgnoreCase();
    void noHiddenFilterShowsAll();
    void nullMoneyEmpty();
    void onlyDumiAccounts();
    void failingQueryShowsMessage();
    void unknownStartKind();
    void severalDirectoriesReadFirst();
    void actLocationThenNext();
    void actLocationWrite_data();
    void actLocationWrite();
    void setAccountKeyReadsNothing();
    void showAccount();

    void companyDetailsRead();
    void companyDetailsEmptyKeepsEarlier();
    void companyDetailsNoRow();
    void companyDetailsUnreachable();
    void setCompDirEmptyList();
    void setCompDirNull();
    void setCompDirFirstEntry();

    void connectionPictureOpensDialog();
};

void TestCard::initTestCase() {
    QVERIFY(dir_.isValid());
    fixture::isolate(dir_);
    seams_ = std::make_unique<host::ScopedSeams>(&messages_, &windows_);
    const QString d = dir_.path();
    QVERIFY(fixture::createDatabase(
        d, QStringLiteral("co1.db"),
        {fixture::companyRow(QStringLiteral("1, 'חברת הדגמה בע\"מ', 'הדגמה',"
                                            " '512345678', '940001234', 'secret'")),
         fixture::accountRow(
             QStringLiteral("1, '1001', 'אבי כהן', '03-1111111',"
                            " 'הרצל 1', 'לקוח ותיק', '', 1234.5, 5000, 0, 'תל אביב', '61000',"
                            " 'מרכז', 7, 0")),
         fixture::accountRow(
             QStringLiteral("2, '1002', 'O''Brien Ltd', '04-2222222',"
                            " 'דרך הים 5', 'ספק', NULL, -250.75, 0, 1500, 'חיפה', '31000', 'צפון',"
                            " 3, 0")),
         fixture::accountRow(QStringLiteral("3, '9999', 'שורת דמה כהן', '03-9999999',"
                                            " 'דמה', 'דמה', '', 0, 0, 0, '', '', '', 0, 1")),
         fixture::accountRow(QStringLiteral(
             "4, '1004', 'חשבון סודי', '02-4444444',"
             " 'סוד 4', 'מנהלים', 'SECRET', 99, 0, 0, 'ירושלים', '91000', '', 1, 0")),
         fixture::accountRow(QStringLiteral("5, '1005', 'דני כהן', NULL, NULL, NULL,"
                                            " NULL, NULL, NULL, NULL, NULL, NULL, NULL, NULL, 0")),
         fixture::accountRow(QStringLiteral("6, '9998', 'דמה אחרונה', '', '', '', '',"
                                            " 0, 0, 0, '', '', '', 0, 1"))}));
    QVERIFY(fixture::createDatabase(
        d, QStringLiteral("co2.db"),
        {fixture::companyRow(QStringLiteral("1, 'חברה שניה', 'שניה', '',"
                                            " NULL, ''")),
         fixture::accountRow(QStringLiteral("1, '2001', 'לקוח שני', '', '', '', '',"
                                            " 10, 0, 0, '', '', '', 0, 0"))}));
    QVERIFY(fixture::createDatabase(
        d, QStringLiteral("co3.db"),
        {fixture::companyRow(QStringLiteral("2, 'שורה 2', 'שתיים', '1', '2',"
                                            " 'x'"))}));
    QVERIFY(fixture::createDatabase(
        d, QStringLiteral("dumionly.db"),
        {fixture::accountRow(QStringLiteral("1, '1', 'דמה', '', '', '', '', 0, 0, 0,"
                                            " '', '', '', 0, 1"))}));
    QVERIFY(fixture::createDatabase(d, QStringLiteral("noaccounts.db"),
                                    {QStringLiteral("DROP TABLE Accounts")}));
}

void TestCard::init() {
    fixture::resetSettings(dir_);
    moduleState() = ModuleState{};
    messages_.clear();
}

void TestCard::cleanupTestCase() {
    seams_.reset();
}

// ---- screen ---------------------------------------------------------------

void TestCard::screenControls_data() {
    QTest::addColumn<QString>("name");
    QTest::addColumn<QString>("caption");
    QTest::addColumn<QString>("toolTip");
    const auto row = [](const char* name, const QString& caption, const QString& tip = {}) {
        QTest::newRow(name) << QString::fromLatin1(name) << caption << tip;
    };
    row("Label1", QStringLiteral(":מפתח חשבון"),
        QStringLiteral("תקתוק כפול לחיפוש לפי מפתח חשבון"));
    row("Label2", QStringLiteral(":שם חשבון"),
        QStringLiteral("תקתוק כפול לחיפוש לפי חלק משם החשבון"));
    row("Label8", QStringLiteral(":טלפון"), QStringLiteral("תקתוק כפול לחיפוש לפי טלפון"));
    row("Label7", QStringLiteral(":כתובת"), QStringLiteral("תקתוק כפול לחיפוש לפי חלק מהכתובת"));
    row("LblDetails", QStringLiteral("פרטים:"));
    row("Label9", QStringLiteral(":עיר"));
    row("Label23", QStringLiteral("שכונה:"));
    row("Label24", QStringLiteral("סוכן:"));
    row("Label3", QStringLiteral(":יתרה"));
    row("Label10", QStringLiteral(":אובליגו"));
    row("Label17", QStringLiteral(" יתרת משלוח:"));
    row("Label4", QStringLiteral(":מחיצות ארדקו"));
    row("Image1", QString(), QStringLiteral("התחברות לארדקו חלונות"));
    row("imgAccKey", QString());
    row("FirstButt", QStringLiteral("החשבון הראשון"), QStringLiteral("לחשבון הראשון"));
    row("PrevButt", QStringLiteral("החשבון הקודם"), QStringLiteral("לחשבון הקודם"));
    row("NextButt", QStringLiteral("החשבון הבא"), QStringLiteral("לחשבון הבא"));
    row("LastButt", QStringLiteral("החשבון האחרון"), QStringLiteral("לחשבון האחרון"));
    row("ShowTransButt", QStringLiteral("שליפת תנועות"));
    row("CmdStop", QStringLiteral("עצור"));
    row("Label14", QStringLiteral("רק פתוחות?"));
    row("Label21", QStringLiteral("שם חשבון נגדי באקסל?"));
    row("Label11", QStringLiteral("הדפס פרטי חשבון?"));
    row("Label15", QStringLiteral("קריאת תנועות לגרף בלבד?"));
    row("PrintButt", QStringLiteral("הצגה להדפסה"));
    row("ExcelButt", QStringLiteral("הצגה לאקסל"));
    row("Label16", QStringLiteral("סוג הגרף:"));
    row("CmdGraph", QStringLiteral("גרף"));
    row("cmdSave", QStringLiteral("שמור הגדרות"));
    row("Label12", QStringLiteral("חיש - תנועה"));
    row("Label13", QStringLiteral("לארדקו"));
    row("Label22", QStringLiteral("גירסה 5.0518"));
    row("Label25", QStringLiteral("XL"));
}

void TestCard::screenControls() {
    QFETCH(QString, name);
    QFETCH(QString, caption);
    QFETCH(QString, toolTip);
    Card card;
    auto* widget = card.findChild<QWidget*>(name);
    QVERIFY2(widget, qPrintable(name));
    if (auto* label = qobject_cast<QLabel*>(widget))
        QCOMPARE(label->text(), caption);
    else
        QCOMPARE(qobject_cast<QPushButton*>(widget)->text(), caption);
    QCOMPARE(widget->toolTip(), toolTip);
}

void TestCard::screenLayout() {
    Card card;
    QCOMPARE(card.layoutDirection(), Qt::RightToLeft);
    QCOMPARE(card.font().family(), QStringLiteral("Arial"));
    for (const QString& name : kBoxes + QStringList{QStringLiteral("txtCompPath")})
        QVERIFY2(card.findChild<QLineEdit*>(name), qPrintable(name));
    for (const char* name :
         {"ChkOnlyOpenTrans", "chkNegdiName", "chkShowHeadDetails", "ChkOnlyGraph"})
        QVERIFY(card.findChild<QCheckBox*>(QString::fromLatin1(name)));
    for (const char* name : {"ProgressFrame", "ProgressFill", "ProgressFrame2", "ProgressFill2"})
        QVERIFY(card.findChild<QFrame*>(QString::fromLatin1(name)));
    QVERIFY(card.findChild<QTableView*>(QStringLiteral("DocLines")));

    auto* type = child<QComboBox>(card, QStringLiteral("CmbGraphType"));
    QCOMPARE(type->count(), 3);
    QCOMPARE(type->itemText(0), QStringLiteral("שבועי"));
    QCOMPARE(type->itemText(1), QStringLiteral("חודשי"));
    QCOMPARE(type->itemText(2), QStringLiteral("רבעוני"));
    auto* date = child<QComboBox>(card, QStringLiteral("CmbGraphDate"));
    QCOMPARE(date->count(), 2);
    QCOMPARE(date->itemText(0), QStringLiteral("לפי תאריך התנועה"));
    QCOMPARE(date->itemText(1), QStringLiteral("לפי תאריך ערך"));

    // The option captions are the labels beside the boxes.
    QCOMPARE(child<QLabel>(card, QStringLiteral("Label14"))->buddy(),
             child<QCheckBox>(card, QStringLiteral("ChkOnlyOpenTrans")));
    QVERIFY(outputsDisabled(card));
}

// ---- first placing -------------------------------------------------------

void TestCard::placingAddress_data() {
    QTest::addColumn<QString>("address");
    QTest::addColumn<QStringList>("texts"); // txtCompPath texts in order
    QTest::newRow("no hash") << QStringLiteral("http://host/card.htm")
                             << QStringList{QStringLiteral("demo.mdb")};
    QTest::newRow("nothing after hash")
        << QStringLiteral("http://host/card.htm#") << QStringList{QStringLiteral("demo.mdb")};
    QTest::newRow("directories") << QStringLiteral("http://host/card.htm#a.db;b.db")
                                 << QStringList{QStringLiteral("a.db;b.db"),
                                                QStringLiteral("demo.mdb")};
    QTest::newRow("second hash kept")
        << QStringLiteral("http://host/card.htm#a.db#x")
        << QStringList{QStringLiteral("a.db#x"), QStringLiteral("demo.mdb")};
}

void TestCard::placingAddress() {
    QFETCH(QString, address);
    QFETCH(QStringList, texts);
    Card card;
    QSignalSpy spy(box(card, QStringLiteral("txtCompPath")), &QLineEdit::textChanged);
    card.InitProperties(host::FixedHostingPage(address, {}));
    QStringList seen;
    for (const QList<QVariant>& args : spy)
        seen << args.at(0).toString();
    QCOMPARE(seen, texts);
    // The stored option (here its default) wins over the address.
    QCOMPARE(moduleState().CompanyDirText, QStringLiteral("demo.mdb"));
    QVERIFY(messages_.messages().isEmpty());
}

void TestCard::placingValues_data() {
    QTest::addColumn<QString>("connType");
    QTest::addColumn<int>("expectedType");
    // Without a stored type the store gives list position 0, type 1.
    QTest::newRow("4") << QStringLiteral("4") << 4;
    QTest::newRow("blanks") << QStringLiteral(" 4 ") << 4;
    QTest::newRow("half to even") << QStringLiteral("2.5") << 2;
    QTest::newRow("rounded") << QStringLiteral("3.6") << 4;
    QTest::newRow("not a number") << QStringLiteral("abc") << 1;
    QTest::newRow("too large") << QStringLiteral("70000") << 1;
    QTest::newRow("empty") << QString() << 1;
}

void TestCard::placingValues() {
    QFETCH(QString, connType);
    QFETCH(int, expectedType);
    Card card;
    host::FixedHostingPage page(QStringLiteral("http://host/card.htm"),
                                {{QStringLiteral("AServer"), dir_.path()},
                                 {QStringLiteral("AUID"), QStringLiteral("clerk")},
                                 {QStringLiteral("APWD"), QStringLiteral("s3cret")},
                                 {QStringLiteral("ADatabase"), QStringLiteral("co2.db;co1.db")}});
    if (!connType.isEmpty())
        page.setValue(QStringLiteral("AConnType"), connType);
    card.InitProperties(page);

    const ModuleState& s = moduleState();
    QCOMPARE(s.conn.ConnServer, dir_.path());
    QCOMPARE(s.conn.ConnUID, QStringLiteral("clerk"));
    QCOMPARE(s.conn.ConnPWD, QStringLiteral("s3cret"));
    QCOMPARE(s.conn.ConnDataBase, QStringLiteral("co2.db;co1.db"));
    QCOMPARE(s.conn.ConnType, expectedType);
    // InitCard split the database value; the stored option took the box.
    QCOMPARE(s.CompanyDirCount, 2);
    QCOMPARE(s.CompanyDirList,
             (QStringList{QString(), QStringLiteral("co2.db"), QStringLiteral("co1.db")}));
    QCOMPARE(box(card, QStringLiteral("txtCompPath"))->text(), QStringLiteral("demo.mdb"));
    QCOMPARE(s.CompanyDirText, QStringLiteral("demo.mdb"));
    // The first company's details were read when the type can reach it.
    QCOMPARE(s.company.ShortName, expectedType == 4 ? QStringLiteral("שניה") : QString());
    // No account key: nothing was looked up.
    QCOMPARE(card.PubACTLocation, 0);
    QCOMPARE(boxTexts(card), kNoAccount);
    QCOMPARE(child<QComboBox>(card, QStringLiteral("CmbGraphType"))->currentIndex(), 1);
    QCOMPARE(child<QComboBox>(card, QStringLiteral("CmbGraphDate"))->currentIndex(), 0);
    QVERIFY(messages_.messages().isEmpty());
}

void TestCard::placingOnlyOpen_data() {
    QTest::addColumn<QString>("value");
    QTest::addColumn<bool>("checked"); // by the placing, before the stored option
    QTest::newRow("1") << QStringLiteral("1") << true;
    QTest::newRow("yes") << QStringLiteral("yes") << true;
    QTest::newRow("TRUE") << QStringLiteral("TRUE") << true;
    QTest::newRow("Yes") << QStringLiteral("Yes") << true;
    QTest::newRow("no") << QStringLiteral("no") << false;
    QTest::newRow("0") << QStringLiteral("0") << false;
    QTest::newRow(" 1 ") << QStringLiteral(" 1 ") << false;
    QTest::newRow("empty") << QString() << false;
}

void TestCard::placingOnlyOpen() {
    QFETCH(QString, value);
    QFETCH(bool, checked);
    Card card;
    auto* box = child<QCheckBox>(card, QStringLiteral("ChkOnlyOpenTrans"));
    QSignalSpy spy(box, &QCheckBox::toggled);
    card.InitProperties(
        host::FixedHostingPage(QStringLiteral("x"), {{QStringLiteral("AOnlyOpen"), value}}));
    if (checked) {
        // Checked by the page, then unchecked by the stored option ("0").
        QCOMPARE(spy.count(), 2);
        QCOMPARE(spy.at(0).at(0).toBool(), true);
        QCOMPARE(spy.at(1).at(0).toBool(), false);
    } else {
        QCOMPARE(spy.count(), 0);
    }
    QVERIFY(!box->isChecked());
}

void TestCard::placingStoredOptionsWin() {
    SaveSetting(kRegApp, kRegSection, QStringLiteral("CompanyDir"), QStringLiteral("co1.db"));
    SaveSetting(kRegApp, kRegSection, QStringLiteral("OnlyOpenTrans"), QStringLiteral("1"));
    SaveSetting(kRegApp, kRegSection, QStringLiteral("ReadNegdiName"), QStringLiteral("1"));
    Card card;
    card.InitProperties(
        host::FixedHostingPage(QStringLiteral("http://host/card.htm#other.db"),
                               {{QStringLiteral("AOnlyOpen"), QStringLiteral("no")}}));
    QCOMPARE(box(card, QStringLiteral("txtCompPath"))->text(), QStringLiteral("co1.db"));
    QCOMPARE(moduleState().CompanyDirText, QStringLiteral("co1.db"));
    QVERIFY(child<QCheckBox>(card, QStringLiteral("ChkOnlyOpenTrans"))->isChecked());
    QVERIFY(child<QCheckBox>(card, QStringLiteral("chkNegdiName"))->isChecked());
    QVERIFY(!child<QCheckBox>(card, QStringLiteral("chkShowHeadDetails"))->isChecked());
}

void TestCard::placingAccountWithQuotes() {
    Card card;
    card.InitProperties(
        host::FixedHostingPage(QStringLiteral("http://host/card.htm#ignored.db"),
                               {{QStringLiteral("AServer"), dir_.path()},
                                {QStringLiteral("AConnType"), QStringLiteral("4")},
                                {QStringLiteral("ADatabase"), QStringLiteral("co1.db")},
                                {QStringLiteral("AAccount"), QStringLiteral("'10\"0,2'")}}));
    QCOMPARE(boxTexts(card), kAccount2);
    QCOMPARE(card.PubACTLocation, 2);
    QCOMPARE(card.PubSearchBy, QStringLiteral("AccountKey"));
    QCOMPARE(card.PubSearchValue.toString(), QStringLiteral("1002"));
    // ShowAccount put the database back into the box.
    QCOMPARE(box(card, QStringLiteral("txtCompPath"))->text(), QStringLiteral("co1.db"));
    QCOMPARE(moduleState().CompanyDirText, QStringLiteral("co1.db"));
    QCOMPARE(moduleState().company.HiddenAccountsFilter, QStringLiteral("secret"));
    QVERIFY(messages_.messages().isEmpty());
}

void TestCard::placingAccountWithoutServer() {
    // A stored empty server: the key is shown, nothing is looked up.
    SaveSetting(kRegApp, kRegSection, QStringLiteral("ConnServer"), QString());
    Card card;
    card.InitProperties(host::FixedHostingPage(
        QStringLiteral("x"), {{QStringLiteral("AAccount"), QStringLiteral("1,0'01")}}));
    QCOMPARE(box(card, QStringLiteral("txtAccountKey"))->text(), QStringLiteral("1001"));
    QCOMPARE(box(card, QStringLiteral("txtAccountName"))->text(), QString());
    QCOMPARE(card.PubACTLocation, 0);
    QVERIFY(messages_.messages().isEmpty());
}

void TestCard::placingEmptyCompanyList() {
    SaveSetting(kRegApp, kRegSection, QStringLiteral("ConnDataBase"), QString());
    SaveSetting(kRegApp, kRegSection, QStringLiteral("ShowHeadDetails"), QStringLiteral("1"));
    Card card;
    card.InitProperties(host::FixedHostingPage(QStringLiteral("x"), {}));
    // No directory to read details from: InitCard goes on to its end.
    QCOMPARE(moduleState().CompanyDirCount, 0);
    QCOMPARE(moduleState().CompanyDirList, QStringList{QString()});
    QCOMPARE(child<QComboBox>(card, QStringLiteral("CmbGraphType"))->currentIndex(), 1);
    QCOMPARE(child<QComboBox>(card, QStringLiteral("CmbGraphDate"))->currentIndex(), 0);
    QVERIFY(child<QCheckBox>(card, QStringLiteral("chkShowHeadDetails"))->isChecked());
    QCOMPARE(box(card, QStringLiteral("txtCompPath"))->text(), QStringLiteral("demo.mdb"));
    QVERIFY(messages_.messages().isEmpty());
}

// ---- company-directory text ----------------------------------------------

void TestCard::typingCompanyPath() {
    auto card = placedCard();
    card->EnableButtons(true);
    QVERIFY(outputsEnabled(*card));
    QLineEdit* path = box(*card, QStringLiteral("txtCompPath"));
    path->clear();
    card->EnableButtons(true);
    QTest::keyClicks(path, QStringLiteral("a"));
    QVERIFY(outputsDisabled(*card));
    QTest::keyClicks(path, QStringLiteral(".db;b.db"));
    QCOMPARE(moduleState().CompanyDirText, QStringLiteral("a.db;b.db"));
    // Typing alone does not split.
    QCOMPARE(moduleState().CompanyDirList, (QStringList{QString(), QStringLiteral("co1.db")}));
}

void TestCard::focusOutSplits() {
    auto card = placedCard();
    QApplication::setActiveWindow(card.get());
    QLineEdit* path = box(*card, QStringLiteral("txtCompPath"));
    path->setFocus();
    QTRY_VERIFY(path->hasFocus());
    path->selectAll();
    QTest::keyClicks(path, QStringLiteral(";a.db;;b.db,c.db,"));
    QCOMPARE(moduleState().CompanyDirCount, 1);
    box(*card, QStringLiteral("txtCity"))->setFocus();
    QTRY_VERIFY(!path->hasFocus());
    QCOMPARE(moduleState().CompanyDirCount, 3);
    QCOMPARE(moduleState().CompanyDirList,
             (QStringList{QString(), QStringLiteral("a.db"), QStringLiteral("b.db"),
                          QStringLiteral("c.db")}));
}

// ---- stored options -------------------------------------------------------

void TestCard::optionsRoundTrip_data() {
    QTest::addColumn<bool>("onlyOpen");
    QTest::addColumn<bool>("negdi");
    QTest::addColumn<bool>("head");
    QTest::newRow("none") << false << false << false;
    QTest::newRow("all") << true << true << true;
    QTest::newRow("only open") << true << false << false;
    QTest::newRow("negdi and head") << false << true << true;
}

void TestCard::optionsRoundTrip() {
    QFETCH(bool, onlyOpen);
    QFETCH(bool, negdi);
    QFETCH(bool, head);
    const auto text = [](bool on) { return on ? QStringLiteral("1") : QStringLiteral("0"); };
    {
        auto card = placedCard();
        box(*card, QStringLiteral("txtCompPath"))->setText(QStringLiteral("a.db;b.db"));
        child<QCheckBox>(*card, QStringLiteral("ChkOnlyOpenTrans"))->setChecked(onlyOpen);
        child<QCheckBox>(*card, QStringLiteral("chkNegdiName"))->setChecked(negdi);
        child<QCheckBox>(*card, QStringLiteral("chkShowHeadDetails"))->setChecked(head);
        moduleState().MainDrive = QStringLiteral("D:");
        moduleState().MainDir = QStringLiteral("\\ardeco");
        click(*card, QStringLiteral("cmdSave"));
        QVERIFY(messages_.messages().isEmpty());
    }
    const auto stored = [](const char* key) {
        return ReadSetting(kRegApp, kRegSection, QString::fromLatin1(key), QStringLiteral("?"));
    };
    QCOMPARE(stored("CompanyDir"), QStringLiteral("a.db;b.db"));
    QCOMPARE(stored("OnlyOpenTrans"), text(onlyOpen));
    QCOMPARE(stored("ReadNegdiName"), text(negdi));
    QCOMPARE(stored("ShowHeadDetails"), text(head));
    QCOMPARE(stored("MainDrive"), QStringLiteral("D:"));
    QCOMPARE(stored("MainDir"), QStringLiteral("\\ardeco"));

    moduleState() = ModuleState{};
    Card card;
    child<QCheckBox>(card, QStringLiteral("ChkOnlyOpenTrans"))->setChecked(!onlyOpen);
    child<QCheckBox>(card, QStringLiteral("chkNegdiName"))->setChecked(!negdi);
    child<QCheckBox>(card, QStringLiteral("chkShowHeadDetails"))->setChecked(!head);
    card.SetGetRegParams(2, QStringLiteral("VL7Trans"), QStringLiteral("Params"));
    QCOMPARE(box(card, QStringLiteral("txtCompPath"))->text(), QStringLiteral("a.db;b.db"));
    QCOMPARE(moduleState().CompanyDirText, QStringLiteral("a.db;b.db"));
    QCOMPARE(child<QCheckBox>(card, QStringLiteral("ChkOnlyOpenTrans"))->isChecked(), onlyOpen);
    QCOMPARE(child<QCheckBox>(card, QStringLiteral("chkNegdiName"))->isChecked(), negdi);
    QCOMPARE(child<QCheckBox>(card, QStringLiteral("chkShowHeadDetails"))->isChecked(), head);
    QCOMPARE(moduleState().MainDrive, QStringLiteral("D:"));
    QCOMPARE(moduleState().MainDir, QStringLiteral("\\ardeco"));
}

void TestCard::optionsMissingCompanyDir() {
    SaveSetting(kRegApp, kRegSection, QStringLiteral("OnlyOpenTrans"), QStringLiteral("yes"));
    Card card;
    box(card, QStringLiteral("txtCompPath"))->setText(QStringLiteral("x.db"));
    child<QCheckBox>(card, QStringLiteral("ChkOnlyOpenTrans"))->setChecked(true);
    card.SetGetRegParams(2, QStringLiteral("VL7Trans"), QStringLiteral("Params"));
    QCOMPARE(box(card, QStringLiteral("txtCompPath"))->text(), QStringLiteral("demo.mdb"));
    // A stored value that is not a number leaves the box as it was.
    QVERIFY(child<QCheckBox>(card, QStringLiteral("ChkOnlyOpenTrans"))->isChecked());
}

void TestCard::optionsOtherActions_data() {
    QTest::addColumn<int>("action");
    QTest::newRow("0") << 0;
    QTest::newRow("3") << 3;
}

void TestCard::optionsOtherActions() {
    QFETCH(int, action);
    Card card;
    QLineEdit* path = box(card, QStringLiteral("txtCompPath"));
    path->setText(QStringLiteral("x.db"));
    moduleState().CompanyDirText = QStringLiteral("other");
    card.SetGetRegParams(action, QStringLiteral("VL7Trans"), QStringLiteral("Params"));
    QCOMPARE(moduleState().CompanyDirText, QStringLiteral("x.db"));
    QCOMPARE(path->text(), QStringLiteral("x.db"));
    QVERIFY(!QFile::exists(fixture::settingsFile(dir_)));
}

void TestCard::optionsSaveFailureShown() {
    // A settings "file" that is a directory cannot be written.
    QVERIFY(QDir().mkpath(fixture::settingsFile(dir_)));
    auto card = placedCard();
    click(*card, QStringLiteral("cmdSave"));
    QCOMPARE(messages_.messages().size(), 1);
    const host::Message& m = messages_.messages().first();
    QCOMPARE(m.title, QStringLiteral("תקלה"));
    QCOMPARE(m.icon, host::MessageIcon::Critical);
    QVERIFY2(m.text.startsWith(QStringLiteral("לא ניתן לשמור את ההגדרות")), qPrintable(m.text));
}

// ---- lookup and navigation ---------------------------------------------------

void TestCard::navigationSteps() {
    auto card = placedCard();
    click(*card, QStringLiteral("FirstButt"));
    QCOMPARE(boxTexts(*card), kAccount1);
    QCOMPARE(card->PubACTLocation, 1);
    click(*card, QStringLiteral("NextButt"));
    QCOMPARE(boxTexts(*card), kAccount2);
    QCOMPARE(moduleState().CurrentAccountFilter, QString());
    // ID 3 is a dummy row; ID 4 is hidden by the company's filter.
    click(*card, QStringLiteral("NextButt"));
    QCOMPARE(boxTexts(*card), kAccount4Hidden);
    QCOMPARE(card->PubACTLocation, 4);
    QCOMPARE(moduleState().CurrentAccountFilter, QStringLiteral("SECRET"));
    click(*card, QStringLiteral("NextButt"));
    QCOMPARE(boxTexts(*card), kAccount5);
    click(*card, QStringLiteral("PrevButt"));
    QCOMPARE(card->PubACTLocation, 4);
    click(*card, QStringLiteral("PrevButt"));
    QCOMPARE(boxTexts(*card), kAccount2);
    click(*card, QStringLiteral("LastButt"));
    QCOMPARE(boxTexts(*card), kAccount5);
    QCOMPARE(card->PubACTLocation, 5);
    QVERIFY(messages_.messages().isEmpty());
}

void TestCard::nextPastLast() {
    auto card = placedCard();
    click(*card, QStringLiteral("LastButt"));
    card->EnableButtons(true);
    click(*card, QStringLiteral("NextButt"));
    QCOMPARE(boxTexts(*card), kNoAccount);
    QCOMPARE(card->PubACTLocation, 0);
    QVERIFY(outputsDisabled(*card));
    click(*card, QStringLiteral("NextButt"));
    QCOMPARE(boxTexts(*card), kAccount1);
}

void TestCard::previousOnFirst() {
    auto card = placedCard();
    click(*card, QStringLiteral("FirstButt"));
    click(*card, QStringLiteral("PrevButt"));
    QCOMPARE(boxTexts(*card), kNoAccount);
    QCOMPARE(card->PubACTLocation, 0);
    click(*card, QStringLiteral("PrevButt"));
    QCOMPARE(boxTexts(*card), kNoAccount);
    QCOMPARE(card->PubACTLocation, 0);
}

void TestCard::lastSkipsDumi() {
    auto card = placedCard();
    card->PubACTLocation = 5;
    QCOMPARE(card->ReadACT7(QStringLiteral("co1.db"), QString(), QString(), QStringLiteral("next")),
             QVariant(true));
    QCOMPARE(card->PubACTLocation, 0); // ID 6 is a dummy row
    card->PubACTLocation = 4;
    card->ReadACT7(QStringLiteral("co1.db"), QString(), QString(), QStringLiteral("PREVIOUS"));
    QCOMPARE(card->PubACTLocation, 2); // ID 3 is a dummy row
}

void TestCard::searches_data() {
    QTest::addColumn<QString>("label");
    QTest::addColumn<QString>("boxName");
    QTest::addColumn<QString>("value");
    QTest::addColumn<QString>("kind");
    QTest::addColumn<int>("id");
    QTest::newRow("key") << QStringLiteral("Label1") << QStringLiteral("txtAccountKey")
                         << QStringLiteral("1002") << QStringLiteral("AccountKey") << 2;
    QTest::newRow("key ignores case")
        << QStringLiteral("Label1") << QStringLiteral("txtAccountKey") << QStringLiteral("1005")
        << QStringLiteral("AccountKey") << 5;
    QTest::newRow("key with quote stripped")
        << QStringLiteral("Label1") << QStringLiteral("txtAccountKey") << QStringLiteral("10'01")
        << QStringLiteral("AccountKey") << 1;
    QTest::newRow("empty key finds none")
        << QStringLiteral("Label1") << QStringLiteral("txtAccountKey") << QString()
        << QStringLiteral("AccountKey") << 0;
    QTest::newRow("name part") << QStringLiteral("Label2") << QStringLiteral("txtAccountName")
                               << QStringLiteral("כהן") << QStringLiteral("AccountName") << 1;
    QTest::newRow("name with apostrophe")
        << QStringLiteral("Label2") << QStringLiteral("txtAccountName") << QStringLiteral("O'Bri")
        << QStringLiteral("AccountName") << 2;
    QTest::newRow("name injection finds none")
        << QStringLiteral("Label2") << QStringLiteral("txtAccountName")
        << QStringLiteral("x' Or '1'='1") << QStringLiteral("AccountName") << 0;
    QTest::newRow("empty name matches all")
        << QStringLiteral("Label2") << QStringLiteral("txtAccountName") << QString()
        << QStringLiteral("AccountName") << 1;
    QTest::newRow("telephone") << QStringLiteral("Label8") << QStringLiteral("txtTelephone")
                               << QStringLiteral("2222") << QStringLiteral("Telephone") << 2;
    QTest::newRow("address") << QStringLiteral("Label7") << QStringLiteral("txtAddress")
                             << QStringLiteral("סוד") << QStringLiteral("Address") << 4;
    QTest::newRow("details") << QStringLiteral("LblDetails") << QStringLiteral("txtDetails")
                             << QStringLiteral("ותיק") << QStringLiteral("Details") << 1;
    QTest::newRow("dummy never found")
        << QStringLiteral("Label8") << QStringLiteral("txtTelephone") << QStringLiteral("9999999")
        << QStringLiteral("Telephone") << 0;
}

void TestCard::searches() {
    QFETCH(QString, label);
    QFETCH(QString, boxName);
    QFETCH(QString, value);
    QFETCH(QString, kind);
    QFETCH(int, id);
    auto card = placedCard();
    card->EnableButtons(true);
    box(*card, boxName)->setText(value);
    doubleClick(*card, label);
    QCOMPARE(card->PubSearchBy, kind);
    QCOMPARE(card->PubACTLocation, id);
    QVERIFY(outputsDisabled(*card));
    if (id == 1)
        QCOMPARE(boxTexts(*card), kAccount1);
    else if (id == 2)
        QCOMPARE(boxTexts(*card), kAccount2);
    else if (id == 4)
        QCOMPARE(boxTexts(*card), kAccount4Hidden);
    else if (id == 5)
        QCOMPARE(boxTexts(*card), kAccount5);
    else
        QCOMPARE(boxTexts(*card), kNoAccount);
    QVERIFY(messages_.messages().isEmpty());
}

void TestCard::searchThenNextThenPrevious() {
    auto card = placedCard();
    box(*card, QStringLiteral("txtAccountName"))->setText(QStringLiteral("כהן"));
    doubleClick(*card, QStringLiteral("Label2"));
    QCOMPARE(card->PubACTLocation, 1);
    // The next match by ID, passing the dummy row 3 that also matches.
    click(*card, QStringLiteral("NextButt"));
    QCOMPARE(boxTexts(*card), kAccount5);
    QCOMPARE(card->PubSearchBy, QStringLiteral("AccountName"));
    QCOMPARE(card->PubSearchValue.toString(), QStringLiteral("כהן"));
    // Previous drops the search: the account just before, matching or not.
    click(*card, QStringLiteral("PrevButt"));
    QCOMPARE(card->PubACTLocation, 4);
    QCOMPARE(card->PubSearchBy, QString());
    QCOMPARE(card->PubSearchValue.toString(), QString());
}

void TestCard::searchValueTrimmed() {
    auto card = placedCard();
    box(*card, QStringLiteral("txtAccountName"))->setText(QStringLiteral("  Brien  "));
    doubleClick(*card, QStringLiteral("Label2"));
    QCOMPARE(card->PubACTLocation, 2);
    QCOMPARE(card->PubSearchValue.toString(), QStringLiteral("Brien"));

    card->PubSearchValue = QStringLiteral(" 1005 ");
    QCOMPARE(card->ReadACT7(QStringLiteral("co1.db"), QStringLiteral("accountkey"),
                            card->PubSearchValue, QStringLiteral("First")),
             QVariant(true));
    QCOMPARE(card->PubACTLocation, 5);
    QCOMPARE(card->PubSearchValue.toString(), QStringLiteral("1005"));
}

void TestCard::hiddenAccountsIgnoreCase() {
    auto card = placedCard();
    moduleState().company.HiddenAccountsFilter = QStringLiteral("SeCrEt");
    box(*card, QStringLiteral("txtAccountKey"))->setText(QStringLiteral("1004"));
    doubleClick(*card, QStringLiteral("Label1"));
    QCOMPARE(boxTexts(*card), kAccount4Hidden);
    QCOMPARE(card->PubACTLocation, 4);
}

void TestCard::noHiddenFilterShowsAll() {
    auto card = placedCard();
    moduleState().company.HiddenAccountsFilter.clear();
    box(*card, QStringLiteral("txtAccountKey"))->setText(QStringLiteral("1004"));
    doubleClick(*card, QStringLiteral("Label1"));
    QCOMPARE(boxTexts(*card),
             (QStringList{QStringLiteral("1004"), QStringLiteral("חשבון סודי"),
                          QStringLiteral("99.00"), QStringLiteral("סוד 4"),
                          QStringLiteral("ירושלים"), QStringLiteral("02-4444444"),
                          QStringLiteral("0.00"), QStringLiteral("0.00"), QStringLiteral("מנהלים"),
                          QStringLiteral("91000"), QString(), QStringLiteral("1")}));
}

void TestCard::nullMoneyEmpty() {
    auto card = placedCard();
    // Fill the boxes first, so that the empty ones are seen to be emptied.
    click(*card, QStringLiteral("FirstButt"));
    box(*card, QStringLiteral("txtAccountKey"))->setText(QStringLiteral("1005"));
    doubleClick(*card, QStringLiteral("Label1"));
    QCOMPARE(boxTexts(*card), kAccount5);
}

void TestCard::onlyDumiAccounts() {
    auto card = placedCard(QStringLiteral("dumionly.db"));
    for (const char* button : {"FirstButt", "LastButt", "NextButt", "PrevButt"}) {
        card->PubACTLocation = 7;
        click(*card, QString::fromLatin1(button));
        QCOMPARE(card->PubACTLocation, 0);
        QCOMPARE(boxTexts(*card), kNoAccount);
    }
    box(*card, QStringLiteral("txtAccountName"))->setText(QString());
    doubleClick(*card, QStringLiteral("Label2"));
    QCOMPARE(card->PubACTLocation, 0);
    QVERIFY(messages_.messages().isEmpty());
}

void TestCard::failingQueryShowsMessage() {
    auto card = placedCard();
    click(*card, QStringLiteral("FirstButt"));
    useCompany(QStringLiteral("noaccounts.db"));
    box(*card, QStringLiteral("txtCompPath"))->setText(QStringLiteral("noaccounts.db"));
    click(*card, QStringLiteral("NextButt"));
    QCOMPARE(messages_.messages().size(), 1);
    const host::Message& m = messages_.messages().first();
    QCOMPARE(m.title, QStringLiteral("תקלה בקריאת החשבונות"));
    QCOMPARE(m.icon, host::MessageIcon::Critical);
    QVERIFY2(m.text.contains(QStringLiteral("no such table: Accounts")), qPrintable(m.text));
    // The boxes keep what they held.
    QCOMPARE(boxTexts(*card), kAccount1);
    QCOMPARE(card->ReadACT7(QStringLiteral("noaccounts.db"), QString(), QString(),
                            QStringLiteral("First")),
             QVariant(false));
}

void TestCard::unknownStartKind() {
    auto card = placedCard();
    QCOMPARE(
        card->ReadACT7(QStringLiteral("co1.db"), QString(), QString(), QStringLiteral("Middle")),
        QVariant(false));
    QCOMPARE(messages_.messages().size(), 1);
    QCOMPARE(messages_.messages().first().title, QStringLiteral("תקלה בקריאת החשבונות"));
}

void TestCard::severalDirectoriesReadFirst() {
    auto card = placedCard(QStringLiteral("co2.db;co1.db"));
    click(*card, QStringLiteral("FirstButt"));
    QCOMPARE(box(*card, QStringLiteral("txtAccountKey"))->text(), QStringLiteral("2001"));
    box(*card, QStringLiteral("txtCompPath"))->setText(QStringLiteral("co1.db,co2.db"));
    click(*card, QStringLiteral("FirstButt"));
    QCOMPARE(boxTexts(*card), kAccount1);
    QVERIFY(messages_.messages().isEmpty());
}

void TestCard::actLocationThenNext() {
    auto card = placedCard();
    card->setProperty("ACTLocation", QStringLiteral("2"));
    QCOMPARE(card->PubACTLocation, 2);
    card->ReadACT7(QStringLiteral("co1.db"), QString(), QString(), QStringLiteral("Next"));
    QCOMPARE(card->PubACTLocation, 4);
    card->setActLocation(5);
    card->ReadACT7(QStringLiteral("co1.db"), QString(), QString(), QStringLiteral("Previous"));
    QCOMPARE(card->PubACTLocation, 4);
    QCOMPARE(card->actLocation(), QVariant(4));
}

void TestCard::actLocationWrite_data() {
    QTest::addColumn<QVariant>("value");
    QTest::addColumn<bool>("fails");
    QTest::addColumn<int>("stored");
    QTest::newRow("text 12") << QVariant(QStringLiteral("12")) << false << 12;
    QTest::newRow("number") << QVariant(77) << false << 77;
    QTest::newRow("half to even") << QVariant(QStringLiteral("6.5")) << false << 6;
    QTest::newRow("not a number") << QVariant(QStringLiteral("abc")) << true << 3;
    QTest::newRow("empty text") << QVariant(QString()) << true << 3;
    QTest::newRow("null") << QVariant() << true << 3;
    QTest::newRow("too large") << QVariant(QStringLiteral("3000000000")) << true << 3;
}

void TestCard::actLocationWrite() {
    QFETCH(QVariant, value);
    QFETCH(bool, fails);
    QFETCH(int, stored);
    Card card;
    card.PubACTLocation = 3;
    bool failed = false;
    try {
        card.setActLocation(value);
    } catch (const Failure&) {
        failed = true;
    }
    QCOMPARE(failed, fails);
    QCOMPARE(card.PubACTLocation, stored);
}

void TestCard::setAccountKeyReadsNothing() {
    auto card = placedCard();
    card->setProperty("SetAccountKey", QStringLiteral("1002"));
    QCOMPARE(box(*card, QStringLiteral("txtAccountKey"))->text(), QStringLiteral("1002"));
    QCOMPARE(card->accountKey(), QVariant(QStringLiteral("1002")));
    QCOMPARE(box(*card, QStringLiteral("txtAccountName"))->text(), QString());
    QCOMPARE(card->PubACTLocation, 0);
    QVERIFY_THROWS_EXCEPTION(Failure, card->setAccountKey(QVariant()));
}

void TestCard::showAccount() {
    auto card = placedCard(QStringLiteral("co2.db"));
    card->EnableButtons(true);
    QCOMPARE(card->ShowAccount(dir_.path(), QStringLiteral("u"), QStringLiteral("p"), 4,
                               QStringLiteral("co1.db;co2.db"), QStringLiteral("1,00'1")),
             0);
    const ModuleState& s = moduleState();
    QCOMPARE(s.conn.ConnServer, dir_.path());
    QCOMPARE(s.conn.ConnUID, QStringLiteral("u"));
    QCOMPARE(s.conn.ConnPWD, QStringLiteral("p"));
    QCOMPARE(s.conn.ConnType, 4);
    QCOMPARE(s.conn.ConnDataBase, QStringLiteral("co1.db;co2.db"));
    QCOMPARE(s.CompanyDirText, QStringLiteral("co1.db;co2.db"));
    QCOMPARE(box(*card, QStringLiteral("txtCompPath"))->text(), QStringLiteral("co1.db;co2.db"));
    QCOMPARE(boxTexts(*card), kAccount1);
    // The fetch splits the text afresh; the company details are not read again,
    // so those of co2 stay.
    QCOMPARE(s.CompanyDirList,
             (QStringList{QString(), QStringLiteral("co1.db"), QStringLiteral("co2.db")}));
    QCOMPARE(s.company.ShortName, QStringLiteral("שניה"));
}

// ---- company details ---------------------------------------------------------

void TestCard::companyDetailsRead() {
    useCompany(QStringLiteral("co1.db"));
    Card card;
    useCompany(QStringLiteral("co1.db"));
    QCOMPARE(card.GetCompDetails7(QStringLiteral("co1.db")), false);
    const CompanyDetails& c = moduleState().company;
    QCOMPARE(c.CompanyName, QStringLiteral("חברת הדגמה בע\"מ"));
    QCOMPARE(c.ShortName, QStringLiteral("הדגמה"));
    QCOMPARE(c.VatNum, QStringLiteral("512345678"));
    QCOMPARE(c.DeductNum, QStringLiteral("940001234"));
    QCOMPARE(c.HiddenAccountsFilter, QStringLiteral("secret"));
    QVERIFY(ReadCompanyDetails(QStringLiteral("co1.db")));
}

void TestCard::companyDetailsEmptyKeepsEarlier() {
    useCompany(QStringLiteral("co1.db"));
    QVERIFY(ReadCompanyDetails(QStringLiteral("co1.db")));
    QVERIFY(ReadCompanyDetails(QStringLiteral("co2.db")));
    const CompanyDetails& c = moduleState().company;
    QCOMPARE(c.CompanyName, QStringLiteral("חברה שניה"));
    QCOMPARE(c.ShortName, QStringLiteral("שניה"));
    QCOMPARE(c.VatNum, QStringLiteral("512345678"));
    QCOMPARE(c.DeductNum, QStringLiteral("940001234"));
    QCOMPARE(c.HiddenAccountsFilter, QStringLiteral("secret"));
}

void TestCard::companyDetailsNoRow() {
    auto card = placedCard();
    card->GetCompDetails7(QStringLiteral("co3.db"));
    QCOMPARE(moduleState().company.ShortName, QStringLiteral("הדגמה"));
    QCOMPARE(moduleState().company.HiddenAccountsFilter, QStringLiteral("secret"));
    QVERIFY(messages_.messages().isEmpty());
}

void TestCard::companyDetailsUnreachable() {
    auto card = placedCard();
    card->GetCompDetails7(QStringLiteral("nowhere.db"));
    moduleState().conn.ConnType = 0;
    card->GetCompDetails7(QStringLiteral("co2.db"));
    QCOMPARE(moduleState().company.ShortName, QStringLiteral("הדגמה"));
    QVERIFY(messages_.messages().isEmpty());
}

void TestCard::setCompDirEmptyList() {
    Card card;
    useCompany(QStringLiteral("co1.db"));
    card.setCompDir(QString());
    QCOMPARE(moduleState().CompanyDirCount, 0);
    QCOMPARE(moduleState().company.ShortName, QString());
    QCOMPARE(card.SetParams(QStringLiteral(";,")), false);
    QCOMPARE(box(card, QStringLiteral("txtCompPath"))->text(), QStringLiteral(";,"));
    QCOMPARE(moduleState().CompanyDirText, QStringLiteral(";,"));
    QCOMPARE(moduleState().company.ShortName, QString());
    // A list that held a directory keeps it; its details are read again.
    QCOMPARE(card.SetParams(QStringLiteral("co2.db")), false);
    QCOMPARE(moduleState().company.ShortName, QStringLiteral("שניה"));
    moduleState().company = CompanyDetails{};
    card.setCompDir(QString());
    QCOMPARE(moduleState().CompanyDirList, (QStringList{QString(), QStringLiteral("co2.db")}));
    QCOMPARE(moduleState().company.ShortName, QStringLiteral("שניה"));
}

void TestCard::setCompDirNull() {
    Card card;
    card.setCompDir(QStringLiteral("a.db"));
    card.setProperty("SetCompDir", QVariant());
    QCOMPARE(moduleState().CompanyDirText, QString());
    QCOMPARE(card.compDir(), QVariant(QString()));
    QCOMPARE(box(card, QStringLiteral("txtCompPath"))->text(), QString());
}

void TestCard::setCompDirFirstEntry() {
    Card card;
    useCompany(QString());
    card.setCompDir(QStringLiteral("co2.db;co1.db"));
    QCOMPARE(moduleState().CompanyDirCount, 2);
    QCOMPARE(moduleState().company.ShortName, QStringLiteral("שניה"));
    QCOMPARE(moduleState().company.HiddenAccountsFilter, QString());
    // The details read takes the first directory of a text as well.
    QVERIFY(ReadCompanyDetails(QStringLiteral("co1.db,co2.db")));
    QCOMPARE(moduleState().company.ShortName, QStringLiteral("הדגמה"));
}

// ---- connection picture ------------------------------------------------------

void TestCard::connectionPictureOpensDialog() {
    auto card = placedCard();
    card->EnableButtons(true);
    int shown = 0;
    const auto cancelSoon = [&] {
        QTimer::singleShot(0, [&] {
            auto* dialog = qobject_cast<frmAConn*>(QApplication::activeModalWidget());
            QVERIFY(dialog);
            ++shown;
            dialog->txtConnDatabase->setText(QStringLiteral("changed.db"));
            QTest::mouseClick(dialog->cmdCancel, Qt::LeftButton);
        });
    };
    moduleState().conn.ConnDataBase = QStringLiteral("co1.db");
    cancelSoon();
    QTest::mouseClick(child<QLabel>(*card, QStringLiteral("Image1")), Qt::LeftButton);
    QCOMPARE(shown, 1);
    // Cancelled: the database in use becomes the company directories.
    QCOMPARE(moduleState().conn.ConnDataBase, QStringLiteral("co1.db"));
    QCOMPARE(moduleState().CompanyDirText, QStringLiteral("co1.db"));
    QCOMPARE(box(*card, QStringLiteral("txtCompPath"))->text(), QStringLiteral("co1.db"));
    QVERIFY(outputsDisabled(*card));

    // Reused, and showing the values in use again.
    moduleState().conn.ConnDataBase = QStringLiteral("co2.db");
    QTimer::singleShot(0, [&] {
        auto* dialog = qobject_cast<frmAConn*>(QApplication::activeModalWidget());
        QVERIFY(dialog);
        ++shown;
        QCOMPARE(dialog->txtConnDatabase->text(), QStringLiteral("co2.db"));
        QTest::mouseClick(dialog->cmdOK, Qt::LeftButton);
    });
    QTest::mouseClick(child<QLabel>(*card, QStringLiteral("Image1")), Qt::LeftButton);
    QCOMPARE(shown, 2);
    QCOMPARE(card->findChildren<frmAConn*>().size(), 1);
    QCOMPARE(box(*card, QStringLiteral("txtCompPath"))->text(), QStringLiteral("co2.db"));
    QCOMPARE(ReadSetting(kRegApp, kRegSection, QStringLiteral("ConnDataBase"), QString()),
             QStringLiteral("co2.db"));
}

} // namespace

QTEST_MAIN(TestCard)
#include "test_card.moc"
