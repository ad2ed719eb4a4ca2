// Hostile data and hostile search values through the real card on the
// offscreen platform: SQL text in searches and keys, LIKE wildcards, markup
// and quotes in every text a page shows, characters windows-1255 does not
// hold, Nulls, huge and odd numbers and dates, a huge company-directory text.
// The company files must come out of every test exactly as they went in.

#include "card/card.h"
#include "card_fixture.h"
#include "common/module_state.h"
#include "connection/conn_string.h"
#include "host/seams.h"
#include "hostile_support.h"
#include "info/ard7info.h"
#include "ledger/ledger_model.h"

#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTest>

using namespace ardcard;

namespace {

// Texts the fixture stores and the pages must show as text.
const QString kMarkupName = QStringLiteral("<b>hostile</b> & \"q\" 'a'");
const QString kMarkupDescription = QStringLiteral("<b>hostile</b> & \"q\"");
const QString kEmojiArabic = QStringLiteral("\U0001F600 مرحبا");
const QString kLongName = QString(10000, QChar(0x05D0));        // alef
const QString kLongDescription = QString(10000, QChar(0x05D1)); // bet
const QString kDropName = QStringLiteral("Robert'); DROP TABLE Accounts; --");

// The same texts as a page must carry them: entities for markup and quotes,
// character references for what windows-1255 cannot hold.
const QByteArray kMarkupNamePage = "&lt;b&gt;hostile&lt;/b&gt; &amp; &quot;q&quot; &#39;a&#39;";
const QByteArray kMarkupDescriptionPage = "&lt;b&gt;hostile&lt;/b&gt; &amp; &quot;q&quot;";
const QByteArray kEmojiArabicPage = "&#128512; &#1605;&#1585;&#1581;&#1576;&#1575;";

QByteArray readFile(const QString& path) {
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

} // namespace

class TestHostile : public QObject {
    Q_OBJECT

private:
    QTemporaryDir root_;
    QString companies_;
    QString temp_;
    host::MessageRecorder messages_;
    host::PageWindowRecorder windows_;
    std::unique_ptr<host::ScopedSeams> seams_;
    QMap<QString, QByteArray> fingerprints_;

    QString tempFile(const char* name) const {
        return QDir(temp_).filePath(QString::fromLatin1(name));
    }
    QString connString() const {
        return BuildConnString(companies_, QStringLiteral("clerk"), hostile::kPassword,
                               QStringLiteral("hostile.db"), 6);
    }

    std::unique_ptr<Card> placedCard(const QString& dirs = QStringLiteral("hostile.db")) {
        auto card = std::make_unique<Card>();
        moduleState().conn = ConnValues{companies_, QStringLiteral("clerk"), hostile::kPassword,
                                        QStringLiteral("hostile.db"), 6};
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
    static QLineEdit* box(const Card& card, const char* name) {
        return child<QLineEdit>(card, name);
    }
    static void click(const Card& card, const char* button) {
        QTest::mouseClick(child<QPushButton>(card, button), Qt::LeftButton);
    }
    static void doubleClick(const Card& card, const char* label) {
        QTest::mouseDClick(child<QLabel>(card, label), Qt::LeftButton);
    }
    // Account 1001 found by its key and its journal fetched.
    std::unique_ptr<Card> fetchedHostileAccount() {
        auto card = placedCard();
        box(*card, "txtAccountKey")->setText(QStringLiteral("1001"));
        doubleClick(*card, "Label1");
        click(*card, "ShowTransButt");
        return card;
    }
    // The grid row of a transaction number, 0 when there is none.
    static int rowOfTransaction(const LedgerModel& ledger, int transId) {
        for (int r = 1; r <= ledger.dataRowCount(); ++r) {
            if (ledger.cellText(r, 3) == QString::number(transId))
                return r;
        }
        return 0;
    }

private Q_SLOTS:
    void initTestCase();
    void init();
    void cleanup();
    void cleanupTestCase();

    void searches_data();
    void searches();
    void nextAfterHostileSearch();
    void showAccountWithHostileKey();
    void accountBoxesShowTextAsIs();
    void nullAccount();

    void fetchHostileLines();
    void statementEscapes();
    void csvStripsAndSubstitutes();
    void graphOfFarYears();
    void accountPageEscapes();
    void nullAccountPage();
    void itemPage_data();
    void itemPage();

    void tenThousandCompanies();
};

void TestHostile::initTestCase() {
    QVERIFY(root_.isValid());
    companies_ = root_.filePath(QStringLiteral("companies"));
    temp_ = root_.filePath(QStringLiteral("temp"));
    const QString config = root_.filePath(QStringLiteral("config"));
    for (const QString& d : {companies_, temp_, config})
        QVERIFY(QDir().mkpath(d));
    qputenv("XDG_CONFIG_HOME", QFile::encodeName(config));
    qputenv("TMPDIR", QFile::encodeName(temp_));
    qputenv("Temp", QFile::encodeName(temp_));
    seams_ = std::make_unique<host::ScopedSeams>(&messages_, &windows_);

    const QString path = QDir(companies_).filePath(QStringLiteral("hostile.db"));
    try {
        demo::CreateCompanyFile(path);
        demo::CompanyWriter w(path);
        using C = demo::CompanyWriter::Columns;
        const QVariant null;
        w.insert(QStringLiteral("CompanyDefenitions"),
                 C{{u"ID"_qs, 1},
                   {u"CompanyName"_qs, u"<i>חברה</i> & שות'"_qs},
                   {u"ShortName"_qs, u"<i>קצר</i> \"ש\""_qs},
                   {u"VatNum"_qs, null},
                   {u"DeductNum"_qs, null},
                   {u"HiddenAccountsFilter"_qs, null}});
        const auto account = [&](int id, const QString& key, const QVariant& name, const C& more) {
            C columns{
                {u"ID"_qs, id}, {u"AccountKey"_qs, key}, {u"FullName"_qs, name}, {u"Dumi"_qs, 0}};
            columns += more;
            w.insert(QStringLiteral("Accounts"), columns);
        };
        account(1, u"1001"_qs, kMarkupName,
                {{u"Phone"_qs, u"03-<i>1</i>"_qs},
                 {u"Address"_qs, kEmojiArabic},
                 {u"Details"_qs, u"<script>alert(1)</script>"_qs},
                 {u"Filter"_qs, u""_qs},
                 {u"Balance"_qs, 1e15},
                 {u"Obligo"_qs, -0.0},
                 {u"Delivery"_qs, null},
                 {u"City"_qs, u"<u>עיר</u>"_qs},
                 {u"Zip"_qs, u"&amp;"_qs},
                 {u"Country"_qs, u"'\""_qs},
                 {u"Agent"_qs, 7},
                 {u"ExFile"_qs, u"x' onclick='alert(1)"_qs},
                 {u"Email"_qs, u"a@b\"><script>"_qs}});
        account(2, u"OB1"_qs, u"O'Brien"_qs, {{u"Phone"_qs, u"04-2"_qs}});
        account(3, u"%"_qs, u"100% pure"_qs, {});
        account(4, u"_"_qs, u"a_b"_qs, {});
        // Every nullable column Null.
        account(5, u"N5"_qs, null, {});
        account(6, u"LONG"_qs, kLongName, {{u"Details"_qs, kLongName}});
        account(7, u"1007"_qs, kDropName, {});

        w.insert(u"Currencies"_qs, C{{u"ID"_qs, 1}, {u"CurrencyCode"_qs, u"ש\"ח"_qs}});
        w.insert(u"Currencies"_qs, C{{u"ID"_qs, 2}, {u"CurrencyCode"_qs, u"<$>"_qs}});
        const auto line = [&](int id, const QString& date, const QVariant& description,
                              const QVariant& costCode, const QString& currency,
                              const QVariant& debId, double amount, int debitCredit,
                              const QVariant& referance) {
            w.insert(u"JurnalTrans"_qs, C{{u"TransID"_qs, id},
                                          {u"Type"_qs, 0},
                                          {u"Status"_qs, 1},
                                          {u"FixedID"_qs, 0},
                                          {u"ValueDate"_qs, date},
                                          {u"DueDate"_qs, date},
                                          {u"BatchNo"_qs, 9},
                                          {u"Referance"_qs, referance},
                                          {u"Ref2"_qs, null},
                                          {u"Description"_qs, description},
                                          {u"CostCode"_qs, costCode},
                                          {u"CurrencyCode"_qs, currency},
                                          {u"TransDebID"_qs, debId},
                                          {u"TransCredID"_qs, u"O'B,2"_qs}});
            w.insert(u"JurnalTransMoves"_qs, C{{u"ID"_qs, id},
                                               {u"TransID"_qs, id},
                                               {u"AccountKey"_qs, u"1001"_qs},
                                               {u"SuF"_qs, amount},
                                               {u"SuFDlr"_qs, amount},
                                               {u"DebitCredit"_qs, debitCredit},
                                               {u"FullMatch"_qs, 0}});
        };
        line(1, u"1900-01-01"_qs, kMarkupDescription, u"<i>c</i>"_qs, u"ש\"ח"_qs, u"<d>"_qs, 1e15,
             0, 5);
        line(2, u"2100-12-31"_qs, kEmojiArabic, null, u"<$>"_qs, u"2002"_qs, -0.0, 0, 6);
        line(3, u"2100-12-30"_qs, null, u"'; DROP TABLE JurnalTrans; --"_qs, u"ש\"ח"_qs, null,
             12.25, 1, null);
        line(4, u"2024-03-06"_qs, kLongDescription, u" "_qs, u"ש\"ח"_qs, u"2002"_qs, 1, 0, 7);

        // The information pages' other sections.
        w.insert(u"ExtraNoteNames"_qs,
                 C{{u"NoteID"_qs, 1}, {u"ItemFlag"_qs, 0}, {u"NoteName"_qs, u"<b>הערה</b>"_qs}});
        w.insert(u"ExtraNotes"_qs, C{{u"ID"_qs, 1},
                                     {u"KeF"_qs, u"1001"_qs},
                                     {u"NoteID"_qs, 1},
                                     {u"ItemFlag"_qs, 0},
                                     {u"Note"_qs, u"</td></tr></table><b>x</b>"_qs}});
        w.insert(u"CRMContact"_qs, C{{u"ID"_qs, 1},
                                     {u"AccountKey"_qs, u"1001"_qs},
                                     {u"CName"_qs, u"<img src=x onerror=alert(1)>"_qs},
                                     {u"CTitle"_qs, kEmojiArabic},
                                     {u"CMail"_qs, null},
                                     {u"CStatus"_qs, 1}});
        w.insert(u"Items"_qs, C{{u"ID"_qs, 1},
                                {u"ItemKey"_qs, u"A'1"_qs},
                                {u"ItemName"_qs, u"<b>item</b> \U0001F600"_qs},
                                {u"ForignName"_qs, u"مرحبا"_qs},
                                {u"Price"_qs, 1e15},
                                {u"Quantity"_qs, -0.0}});
        w.insert(u"DocumentsDef"_qs,
                 C{{u"DocumentID"_qs, 1}, {u"DocName"_qs, u"<b>חשבונית</b>"_qs}});
        w.commit();
    } catch (const Failure& failure) {
        QFAIL(qPrintable(failure.description()));
    }

    // A small company read ten thousand times.
    QVERIFY(fixture::createDatabase(
        companies_, QStringLiteral("small.db"),
        {fixture::accountRow(QStringLiteral("1, '1001', 'קטן', '', '', '', '', 0, 0, 0, '', '',"
                                            " '', 0, 0")),
         QStringLiteral("INSERT INTO Currencies (ID, CurrencyCode) VALUES (1, 'ש\"ח')"),
         QStringLiteral("INSERT INTO JurnalTrans (TransID, Type, Status, FixedID, ValueDate,"
                        " DueDate, BatchNo, Referance, Ref2, Description, CostCode,"
                        " CurrencyCode, TransDebID, TransCredID) VALUES (1, 0, 1, 0,"
                        " '2024-01-02', '2024-01-02', 1, 1, 0, 'x', '', 'ש\"ח', '2', '3')"),
         QStringLiteral("INSERT INTO JurnalTransMoves (ID, TransID, AccountKey, SuF, SuFDlr,"
                        " DebitCredit, FullMatch) VALUES (1, 1, '1001', 3, 0, 0, 0)")}));

    for (const char* file : {"hostile.db", "small.db"}) {
        const QString p = QDir(companies_).filePath(QString::fromLatin1(file));
        fingerprints_.insert(p, hostile::fingerprint(p));
    }
}

void TestHostile::init() {
    moduleState() = ModuleState{};
    messages_.clear();
    windows_.clear();
}

void TestHostile::cleanup() {
    QVERIFY2(hostile::leakingMessages(messages_.messages()).isEmpty(),
             qPrintable(hostile::leakingMessages(messages_.messages()).join(u'\n')));
    for (auto it = fingerprints_.cbegin(); it != fingerprints_.cend(); ++it)
        QVERIFY2(hostile::fingerprint(it.key()) == it.value(), qPrintable(it.key()));
    QVERIFY(hostile::openFilesUnder(root_.path()).isEmpty());
}

void TestHostile::cleanupTestCase() {
    seams_.reset();
}

// ---- searches -------------------------------------------------------------------

void TestHostile::searches_data() {
    QTest::addColumn<QString>("label");
    QTest::addColumn<QString>("boxName");
    QTest::addColumn<QString>("value");
    QTest::addColumn<int>("id"); // the account shown, 0 for none
    QTest::addColumn<QString>("key");

    const QString none;
    const auto row = [](const char* name, const char* label, const char* boxName,
                        const QString& value, int id, const QString& key) {
        QTest::newRow(name) << QString::fromLatin1(label) << QString::fromLatin1(boxName) << value
                            << id << key;
    };
    const QString orTrue = QStringLiteral("' OR 1=1 --");
    const QString drop = QStringLiteral("'; DROP TABLE Accounts; --");
    // The key search drops quotes and commas, then matches the key exactly.
    row("key, or-true", "Label1", "txtAccountKey", orTrue, 0, none);
    row("key, drop", "Label1", "txtAccountKey", drop, 0, none);
    row("key, percent", "Label1", "txtAccountKey", u"%"_qs, 3, u"%"_qs);
    row("key, underscore", "Label1", "txtAccountKey", u"_"_qs, 4, u"_"_qs);
    row("key, plain", "Label1", "txtAccountKey", u"OB1"_qs, 2, u"OB1"_qs);
    row("key, quoted plain", "Label1", "txtAccountKey", u"'OB1'"_qs, 2, u"OB1"_qs);
    row("key, long", "Label1", "txtAccountKey", kLongName, 0, none);
    // The part searches take the value as text, quotes and all.
    for (const auto& [label, boxName] :
         {std::pair{"Label2", "txtAccountName"}, std::pair{"Label8", "txtTelephone"},
          std::pair{"Label7", "txtAddress"}, std::pair{"LblDetails", "txtDetails"}}) {
        const QByteArray l(label);
        row(l + ", or-true", label, boxName, orTrue, 0, none);
        row(l + ", drop", label, boxName, drop, 0, none);
        // Only a name holds a quote.
        row(l + ", lone quote", label, boxName, u"'"_qs, l == "Label2" ? 1 : 0,
            l == "Label2" ? u"1001"_qs : none);
    }
    row("name, O'Brien", "Label2", "txtAccountName", u"O'Brien"_qs, 2, u"OB1"_qs);
    row("name, the drop account itself", "Label2", "txtAccountName",
        u"'); DROP TABLE Accounts; --"_qs, 7, u"1007"_qs);
    row("name, markup", "Label2", "txtAccountName", u"<b>hostile</b>"_qs, 1, u"1001"_qs);
    row("name, long", "Label2", "txtAccountName", kLongName, 6, u"LONG"_qs);
    row("name, longer than any", "Label2", "txtAccountName", kLongName + u'א', 0, none);
    row("name, emoji", "Label2", "txtAccountName", u"\U0001F600"_qs, 0, none);
    row("address, emoji and Arabic", "Label7", "txtAddress", kEmojiArabic, 1, u"1001"_qs);
    row("address, Arabic", "Label7", "txtAddress", u"مرحبا"_qs, 1, u"1001"_qs);
    row("details, script", "LblDetails", "txtDetails", u"<script>"_qs, 1, u"1001"_qs);
    row("details, long", "LblDetails", "txtDetails", kLongName, 6, u"LONG"_qs);
    row("telephone, markup", "Label8", "txtTelephone", u"<i>1</i>"_qs, 1, u"1001"_qs);
    // The part searches are LIKE patterns: % and _ are wildcards, as in the
    // host product's own searches, so they match every name that has a
    // character there; the first such account by ID is shown.
    row("name, percent", "Label2", "txtAccountName", u"%"_qs, 1, u"1001"_qs);
    row("name, underscore", "Label2", "txtAccountName", u"_"_qs, 1, u"1001"_qs);
    row("name, percent after digits", "Label2", "txtAccountName", u"100%"_qs, 3, u"%"_qs);
    row("name, underscore between", "Label2", "txtAccountName", u"a_b"_qs, 4, u"_"_qs);
}

void TestHostile::searches() {
    QFETCH(QString, label);
    QFETCH(QString, boxName);
    QFETCH(QString, value);
    QFETCH(int, id);
    QFETCH(QString, key);
    auto card = placedCard();
    // Something on show first, so that "none found" is seen to empty the boxes.
    click(*card, "FirstButt");
    QCOMPARE(card->PubACTLocation, 1);

    box(*card, qPrintable(boxName))->setText(value);
    doubleClick(*card, qPrintable(label));
    QVERIFY2(messages_.messages().isEmpty(),
             messages_.messages().isEmpty() ? "" : qPrintable(messages_.messages().first().text));
    QCOMPARE(card->PubACTLocation, id);
    QCOMPARE(box(*card, "txtAccountKey")->text(), key);
    if (id == 0)
        QCOMPARE(box(*card, "txtAccountName")->text(), QString());
}

void TestHostile::nextAfterHostileSearch() {
    auto card = placedCard();
    box(*card, "txtAccountName")->setText(QStringLiteral("'"));
    doubleClick(*card, "Label2");
    QCOMPARE(card->PubACTLocation, 1); // ... 'a'
    click(*card, "NextButt");
    QCOMPARE(card->PubACTLocation, 2); // O'Brien
    click(*card, "NextButt");
    QCOMPARE(card->PubACTLocation, 7); // Robert'); ...
    click(*card, "NextButt");
    QCOMPARE(card->PubACTLocation, 0);
    QVERIFY(messages_.messages().isEmpty());
}

void TestHostile::showAccountWithHostileKey() {
    auto card = placedCard();
    for (const QString& key :
         {QStringLiteral("' OR 1=1 --"), QStringLiteral("'; DROP TABLE Accounts; --"),
          QStringLiteral("%"), kLongName, QStringLiteral("\U0001F600")}) {
        QCOMPARE(card->ShowAccount(companies_, QStringLiteral("clerk"), hostile::kPassword, 6,
                                   QStringLiteral("hostile.db"), key),
                 0);
        const int expected = key == QStringLiteral("%") ? 3 : 0;
        QCOMPARE(card->PubACTLocation, expected);
        QCOMPARE(card->ledger().dataRowCount(), 0);
    }
    QVERIFY(messages_.messages().isEmpty());
}

void TestHostile::accountBoxesShowTextAsIs() {
    auto card = placedCard();
    box(*card, "txtAccountKey")->setText(QStringLiteral("1001"));
    doubleClick(*card, "Label1");
    QCOMPARE(box(*card, "txtAccountName")->text(), kMarkupName);
    QCOMPARE(box(*card, "txtAddress")->text(), kEmojiArabic);
    QCOMPARE(box(*card, "txtDetails")->text(), QStringLiteral("<script>alert(1)</script>"));
    QCOMPARE(box(*card, "txtBalance")->text(), QStringLiteral("1,000,000,000,000,000.00"));
    QCOMPARE(box(*card, "txtOblig")->text(), QStringLiteral("0.00")); // -0.0 has no sign
    QCOMPARE(box(*card, "txtShipBalance")->text(), QString());        // Null
    QCOMPARE(box(*card, "txtZip")->text(), QStringLiteral("&amp;"));
    QCOMPARE(box(*card, "txtDistrict")->text(), QStringLiteral("'\""));
    QCOMPARE(box(*card, "txtAgent")->text(), QStringLiteral("7"));

    box(*card, "txtAccountKey")->setText(QStringLiteral("LONG"));
    doubleClick(*card, "Label1");
    QCOMPARE(box(*card, "txtAccountName")->text(), kLongName);
    QVERIFY(messages_.messages().isEmpty());
}

void TestHostile::nullAccount() {
    auto card = placedCard();
    box(*card, "txtAccountKey")->setText(QStringLiteral("N5"));
    doubleClick(*card, "Label1");
    QCOMPARE(card->PubACTLocation, 5);
    QCOMPARE(box(*card, "txtAccountKey")->text(), QStringLiteral("N5"));
    for (const char* name :
         {"txtAccountName", "txtBalance", "txtAddress", "txtCity", "txtTelephone", "txtOblig",
          "txtShipBalance", "txtDetails", "txtZip", "txtDistrict", "txtAgent"})
        QVERIFY2(box(*card, name)->text().isEmpty(), name);
    // No journal lines: the fetch reads none, and every output still works.
    click(*card, "ShowTransButt");
    QCOMPARE(card->ledger().dataRowCount(), 0);
    click(*card, "PrintButt");
    click(*card, "ExcelButt");
    QVERIFY(messages_.messages().isEmpty());
    QCOMPARE(windows_.windows().size(), 2);
    // Heading rows are written for non-empty values only: the key alone.
    const QByteArray page = readFile(tempFile("vlprint.htm"));
    QVERIFY(page.contains("<b>N5</b>"));
}

// ---- the fetch and the outputs ------------------------------------------------

void TestHostile::fetchHostileLines() {
    auto card = fetchedHostileAccount();
    QVERIFY(messages_.messages().isEmpty());
    const LedgerModel& ledger = card->ledger();
    QCOMPARE(ledger.dataRowCount(), 4);

    const int r1 = rowOfTransaction(ledger, 1);
    QVERIFY(r1 > 0);
    QCOMPARE(ledger.cellText(r1, 1), QStringLiteral("01/01/00"));
    QCOMPARE(ledger.cellText(r1, 5), QStringLiteral("5"));
    QCOMPARE(ledger.cellText(r1, 7), kMarkupDescription);
    QCOMPARE(ledger.cellText(r1, 8), QStringLiteral("1,000,000,000,000,000.00"));
    QCOMPARE(ledger.cellText(r1, 12), QStringLiteral("<i>c</i>"));
    QCOMPARE(ledger.rowDetail(r1).CounterKey, QStringLiteral("<d>"));

    const int r2 = rowOfTransaction(ledger, 2);
    QCOMPARE(ledger.cellText(r2, 1), QStringLiteral("31/12/00"));
    QCOMPARE(ledger.cellText(r2, 7), kEmojiArabic);
    QCOMPARE(ledger.cellText(r2, 8), QStringLiteral("0.00"));
    QCOMPARE(ledger.cellText(r2, 9), QStringLiteral("0.00"));
    QCOMPARE(ledger.cellText(r2, 10), QStringLiteral("<$>"));
    QCOMPARE(ledger.cellText(r2, 12), QStringLiteral(" ")); // Null

    const int r3 = rowOfTransaction(ledger, 3);
    QCOMPARE(ledger.cellText(r3, 5), QStringLiteral("0")); // Null
    QCOMPARE(ledger.cellText(r3, 6), QStringLiteral("0")); // Null
    QCOMPARE(ledger.cellText(r3, 7), QStringLiteral(" ")); // Null
    QCOMPARE(ledger.cellText(r3, 8), QStringLiteral("-12.25"));
    QCOMPARE(ledger.rowDetail(r3).CounterKey, QStringLiteral("O'B,2"));

    const int r4 = rowOfTransaction(ledger, 4);
    QCOMPARE(ledger.cellText(r4, 7), kLongDescription);
    QCOMPARE(ledger.rowDetail(r4).CounterKey, QStringLiteral("2002"));
}

void TestHostile::statementEscapes() {
    auto card = fetchedHostileAccount();
    child<QCheckBox>(*card, "chkShowHeadDetails")->setChecked(true);
    click(*card, "PrintButt");
    QVERIFY(messages_.messages().isEmpty());
    QCOMPARE(windows_.windows().size(), 1);
    const QByteArray page = readFile(tempFile("vlprint.htm"));
    QVERIFY(!page.isEmpty());

    // Heading values.
    QVERIFY(page.contains("     <td width='70%' align='right'><b>" + kMarkupNamePage +
                          "</b></td>\r\n"));
    QVERIFY(page.contains("     <td width='70%' align='right'><b>" + kEmojiArabicPage +
                          "</b></td>\r\n"));
    QVERIFY(page.contains("     <td width='70%' align='right'><b>&lt;script&gt;alert(1)&lt;/"
                          "script&gt;</b></td>\r\n"));
    QVERIFY(page.contains("     <td width='70%' align='right'><b>03-&lt;i&gt;1&lt;/i&gt;</b>"
                          "</td>\r\n"));
    // Cells.
    QVERIFY(page.contains("    <td>" + kMarkupDescriptionPage + "</td>\r\n"));
    QVERIFY(page.contains("    <td>" + kEmojiArabicPage + "</td>\r\n"));
    QVERIFY(page.contains("    <td>&lt;i&gt;c&lt;/i&gt;</td>\r\n"));
    QVERIFY(page.contains("    <td>&lt;$&gt;</td>\r\n"));
    QVERIFY(page.contains("    <td>&#39;; DROP TABLE JurnalTrans; --</td>\r\n"));
    QVERIFY(page.contains("    <td>" + QByteArray(10000, '\xE1') + "</td>\r\n"));
    QVERIFY(page.contains("    <td>1,000,000,000,000,000.00</td>\r\n"));
    // No markup from the data reaches the page as markup.
    for (const char* raw : {"<b>hostile", "<script>", "<i>c</i>", "<$>", "<i>1</i>", "<u>"})
        QVERIFY2(!page.contains(raw), raw);
}

void TestHostile::csvStripsAndSubstitutes() {
    auto card = fetchedHostileAccount();
    click(*card, "ExcelButt");
    QVERIFY(messages_.messages().isEmpty());
    const QByteArray csv = readFile(tempFile("vltrans1.csv"));
    const QList<QByteArray> lines = csv.split('\n');
    QCOMPARE(lines.size(), 6); // header, four rows, nothing after the last CR LF
    QVERIFY(lines.last().isEmpty());
    for (qsizetype i = 1; i <= 4; ++i) {
        QVERIFY(lines[i].endsWith('\r'));
        // 14 fields each: one company, counter names off.
        QCOMPARE(lines[i].count(','), 13);
    }
    // Quotes and commas dropped, markup kept as the text it is, characters
    // outside windows-1255 as "?".
    QVERIFY(csv.contains(",<b>hostile</b> & q,1000000000000000.00,"));
    QVERIFY(csv.contains(",? ?????,0.00,0.00,<$>,"));
    QVERIFY(csv.contains(",; DROP TABLE JurnalTrans; --,OB2\r\n"));
    QVERIFY(csv.contains(",<i>c</i>,<d>\r\n"));
    QVERIFY(csv.contains("," + QByteArray(10000, '\xE1') + ",1.00,"));

    // The link page escapes the path it links to.
    const QByteArray page = readFile(tempFile("vltrans1.htm"));
    QVERIFY(page.contains("<A HREF='" + QFile::encodeName(tempFile("vltrans1.csv")) + "'"));
}

void TestHostile::graphOfFarYears() {
    auto card = fetchedHostileAccount();
    child<QComboBox>(*card, "CmbGraphType")->setCurrentIndex(1); // monthly
    click(*card, "CmdGraph");
    QVERIFY(messages_.messages().isEmpty());
    QCOMPARE(windows_.windows().size(), 1);
    const QByteArray page = readFile(tempFile("vtransg.htm"));
    // The company's short name, markup and quotes as text.
    QVERIFY(page.contains("<div class=Title1 align='center'>&lt;i&gt;"));
    // Newest first: December 2100 (-12.25 and the -0.0 line), March 2024,
    // January 1900 (the 1e15 line, the widest bar).
    const qsizetype dec2100 = page.indexOf("<td align='right' width='8%'>12/2100</td>");
    const qsizetype mar2024 = page.indexOf("<td align='right' width='8%'>3/2024</td>");
    const qsizetype jan1900 = page.indexOf("<td align='right' width='8%'>1/1900</td>");
    QVERIFY(dec2100 > 0);
    QVERIFY(mar2024 > dec2100);
    QVERIFY(jan1900 > mar2024);
    QVERIFY(page.contains(" width='100%' border='0' bgcolor='#80FFA0'><tr><td height='30' "
                          "align='center'>1,000,000,000,000,000</td><tr></table></td>\r\n"));
    QVERIFY(page.contains(" width='0%' border='0' bgcolor='#FFC8E0'><tr><td height='30' "
                          "align='center'>-12</td><tr></table></td>\r\n"));
    QVERIFY(page.contains("<div class=MyClass2 align='center'><b>" + kMarkupNamePage +
                          " - 1001</b></div>\r\n"));
    QVERIFY(!page.contains("<b>hostile"));
    QVERIFY(!page.contains("<i>"));
}

void TestHostile::accountPageEscapes() {
    auto card = placedCard();
    box(*card, "txtAccountKey")->setText(QStringLiteral("1001"));
    doubleClick(*card, "Label1");
    QTest::mouseDClick(child<QLabel>(*card, "imgAccKey"), Qt::LeftButton);
    QVERIFY2(messages_.messages().isEmpty(),
             messages_.messages().isEmpty() ? "" : qPrintable(messages_.messages().first().text));
    QCOMPARE(windows_.windows().size(), 1);
    QCOMPARE(windows_.windows().first(),
             (QStringList{tempFile("vlicrd0.htm"), tempFile("vlicrd1.htm")}));
    const QByteArray page = readFile(tempFile("vlicrd1.htm"));
    QVERIFY(page.contains("     <td><b>" + kMarkupNamePage + "</b></td>\r\n"));
    QVERIFY(page.contains(kEmojiArabicPage));
    QVERIFY(page.contains("&lt;script&gt;alert(1)&lt;/script&gt;"));
    QVERIFY(page.contains("<a href='x&#39; onclick=&#39;alert(1)' target='_blank'>"));
    QVERIFY(page.contains("&lt;/td&gt;&lt;/tr&gt;&lt;/table&gt;&lt;b&gt;x&lt;/b&gt;"));
    QVERIFY(page.contains("&lt;img src=x onerror=alert(1)&gt;"));
    QVERIFY(page.contains("a@b&quot;&gt;&lt;script&gt;"));
    for (const char* raw : {"<b>hostile", "<script", "<img", "<b>x</b>", "<u>", "' onclick"})
        QVERIFY2(!page.contains(raw), raw);
}

void TestHostile::nullAccountPage() {
    Ard7Info info;
    info.OpenAccountHTML(QStringLiteral("N5"), connString(), 6);
    QVERIFY(messages_.messages().isEmpty());
    const QByteArray page = readFile(tempFile("vlicrd1.htm"));
    QVERIFY(page.contains("     <td><b>N5</b></td>\r\n"));
    QVERIFY(page.contains("     <td><b>&nbsp;</b></td>\r\n")); // the Null name
    QVERIFY(page.endsWith("</HTML>\r\n"));
}

void TestHostile::itemPage_data() {
    QTest::addColumn<QString>("key");
    QTest::addColumn<bool>("found");
    QTest::newRow("quote in the key") << QStringLiteral("A'1") << true;
    QTest::newRow("or-true") << QStringLiteral("' OR 1=1 --") << false;
    QTest::newRow("drop") << QStringLiteral("'; DROP TABLE Items; --") << false;
    QTest::newRow("percent") << QStringLiteral("%") << false;
    QTest::newRow("long") << kLongName << false;
    QTest::newRow("emoji") << QStringLiteral("\U0001F600") << false;
}

void TestHostile::itemPage() {
    QFETCH(QString, key);
    QFETCH(bool, found);
    Ard7Info info;
    info.OpenItemHTML(key, connString(), 6);
    QVERIFY(messages_.messages().isEmpty());
    QCOMPARE(windows_.windows().size(), 1);
    const QByteArray page = readFile(tempFile("vlicrd1.htm"));
    if (!found) {
        // A key that matches no item gives the empty page.
        QVERIFY(page.isEmpty());
        return;
    }
    QVERIFY(page.contains("&lt;b&gt;item&lt;/b&gt; &#128512;"));
    QVERIFY(page.contains("&#1605;&#1585;&#1581;&#1576;&#1575;"));
    QVERIFY(page.contains("A&#39;1"));
    QVERIFY(!page.contains("<b>item"));
}

// ---- a huge company-directory text ----------------------------------------------

void TestHostile::tenThousandCompanies() {
    QString dirs;
    for (int i = 0; i < 10000; ++i)
        dirs += QStringLiteral("small.db;");
    // Not shown: ten thousand repaints of the grid at the yields would cost
    // more than the reads.
    auto card = std::make_unique<Card>();
    moduleState().conn = ConnValues{companies_, QStringLiteral("clerk"), hostile::kPassword,
                                    QStringLiteral("small.db"), 6};
    card->setCompDir(dirs);
    box(*card, "txtAccountKey")->setText(QStringLiteral("1001"));
    click(*card, "ShowTransButt");
    QVERIFY2(messages_.messages().isEmpty(),
             messages_.messages().isEmpty() ? "" : qPrintable(messages_.messages().first().text));
    QCOMPARE(moduleState().CompanyDirCount, 10000);
    const LedgerModel& ledger = card->ledger();
    QCOMPARE(ledger.dataRowCount(), 10000);
    QCOMPARE(ledger.rowDetail(1).CompIndex, 1);
    QCOMPARE(ledger.rowDetail(9999).CompIndex, 9999);
    QCOMPARE(ledger.rowDetail(10000).CompIndex, 10000);
    // The running balance starts afresh with each company.
    QCOMPARE(ledger.cellText(10000, 0), QStringLiteral("1"));
    QCOMPARE(ledger.cellText(10000, 11), QStringLiteral("3.00"));

    click(*card, "ExcelButt");
    QVERIFY(messages_.messages().isEmpty());
    const QByteArray csv = readFile(tempFile("vltrans1.csv"));
    QCOMPARE(csv.count('\n'), 10001);
    QVERIFY(csv.endsWith(",2,small.db\r\n"));
}

QTEST_MAIN(TestHostile)
#include "test_hostile.moc"
