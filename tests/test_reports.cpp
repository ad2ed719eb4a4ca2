// The statement, the CSV export with its page and the graph page, each
// compared byte for byte with a reference file in tests/reference/reports/.
//
// The references are UTF-8 text (LF or CR LF); the output is windows-1255
// with CR LF and is decoded with ICU before the comparison. "{TODAY}" in a
// reference stands for today's date as dd/mm/yyyy.
//
// To see a diff after a failure, keep the decoded output:
//   ARDCARD_REPORTS_KEEP=/tmp/out build/tests/test_reports
//   diff -u --strip-trailing-cr tests/reference/reports/<file> /tmp/out/<file>

#include "card/card.h"
#include "common/failure.h"
#include "common/module_state.h"
#include "common/text_file_writer.h"
#include "host/seams.h"
#include "ledger/ledger_model.h"
#include "reports/csv_writer.h"
#include "reports/graph_writer.h"
#include "reports/output_command.h"
#include "reports/page_markup.h"
#include "reports/report_screen.h"
#include "reports/statement_writer.h"

#include <QCheckBox>
#include <QComboBox>
#include <QDate>
#include <QDir>
#include <QFile>
#include <QLineEdit>
#include <QPushButton>
#include <QTemporaryDir>
#include <QTest>
#include <memory>
#include <random>
#include <unicode/ucnv.h>

using namespace ardcard;
using namespace ardcard::reports;

namespace {

QString referenceDir() {
    return QStringLiteral(ARDCARD_REFERENCE_DIR);
}

// The output file's bytes as text, decoded from windows-1255 by ICU.
QString decodeWindows1255(const QByteArray& bytes) {
    UErrorCode status = U_ZERO_ERROR;
    std::unique_ptr<UConverter, void (*)(UConverter*)> conv(ucnv_open("windows-1255", &status),
                                                            ucnv_close);
    if (U_FAILURE(status))
        return QStringLiteral("<no windows-1255 converter>");
    QString out(bytes.size() + 1, Qt::Uninitialized);
    const int32_t n = ucnv_toUChars(conv.get(), reinterpret_cast<UChar*>(out.data()),
                                    static_cast<int32_t>(out.size()), bytes.constData(),
                                    static_cast<int32_t>(bytes.size()), &status);
    if (U_FAILURE(status))
        return QStringLiteral("<undecodable output>");
    out.truncate(n);
    return out;
}

// The reference with CR LF line ends and today's date in place.
QString expectedText(const QString& name) {
    QFile file(referenceDir() + u'/' + name);
    if (!file.open(QIODevice::ReadOnly))
        return QStringLiteral("<missing reference %1>").arg(name);
    QString text = QString::fromUtf8(file.readAll());
    text.replace(QStringLiteral("\r\n"), QStringLiteral("\n"));
    text.replace(u'\n', QStringLiteral("\r\n"));
    text.replace(QStringLiteral("{TODAY}"),
                 QDate::currentDate().toString(QStringLiteral("dd/MM/yyyy")));
    return text;
}

QString actualText(const QString& path) {
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly))
        return QStringLiteral("<no output file>");
    return decodeWindows1255(file.readAll());
}

// Compares the whole file; on a difference names the first differing line.
void compareWithReference(const QString& path, const QString& reference) {
    const QString actual = actualText(path);
    const QString expected = expectedText(reference);
    const QString keep = qEnvironmentVariable("ARDCARD_REPORTS_KEEP");
    if (!keep.isEmpty()) {
        QDir().mkpath(keep);
        QFile out(keep + u'/' + reference);
        if (out.open(QIODevice::WriteOnly))
            out.write(actual.toUtf8());
    }
    if (actual == expected)
        return;
    const QStringList a = actual.split(QStringLiteral("\r\n"));
    const QStringList e = expected.split(QStringLiteral("\r\n"));
    for (qsizetype i = 0; i < std::min(a.size(), e.size()); ++i) {
        if (a[i] != e[i]) {
            QCOMPARE(a[i], e[i]);
            return;
        }
    }
    QCOMPARE(a.size(), e.size());
    QCOMPARE(actual, expected); // same lines, different line ends
}

RowDetail detail(int company, const QString& key, const QString& name) {
    RowDetail d;
    d.CompIndex = company;
    d.CounterKey = key;
    d.CounterName = name;
    return d;
}

// Row A: a markup description, company 1.
LedgerRow rowA() {
    LedgerRow r;
    r.rowNumber = 1;
    r.valueDate = QDate(2024, 3, 5);
    r.batchNo = 12;
    r.transId = 10;
    r.dueDate = QDate(2024, 3, 20);
    r.referance = 1001;
    r.ref2 = 0;
    r.description = QStringLiteral("<b>A & B</b>");
    r.amount = 1234.5;
    r.foreignAmount = 300;
    r.currencyCode = QStringLiteral("USD");
    r.balance = 1234.5;
    r.costCode = QStringLiteral(" ");
    r.currencyId = 2;
    r.detail = detail(1, QStringLiteral("2001"), QStringLiteral("ספק ראשון"));
    return r;
}

// Row B: a comma and quotes in the details, a quote in the counter key.
LedgerRow rowB() {
    LedgerRow r;
    r.rowNumber = 2;
    r.valueDate = QDate(2024, 4, 1);
    r.batchNo = 13;
    r.transId = 30;
    r.dueDate = QDate(2024, 4, 1);
    r.referance = 1002;
    r.ref2 = 7;
    r.description = QStringLiteral("תשלום, חלקי \"מקדמה\"");
    r.amount = -200;
    r.foreignAmount = -50.25;
    r.currencyCode = QStringLiteral("USD");
    r.balance = 1034.5;
    r.costCode = QStringLiteral("A1");
    r.currencyId = 2;
    r.detail = detail(1, QStringLiteral("2'002"), QStringLiteral("לקוח \"ב\""));
    return r;
}

// Row C: company 2, a character outside windows-1255, a costing cell of
// quotes and a comma only.
LedgerRow rowC() {
    LedgerRow r;
    r.rowNumber = 1;
    r.valueDate = QDate(2024, 3, 15);
    r.batchNo = 5;
    r.transId = 20;
    r.dueDate = QDate(2024, 3, 15);
    r.description = QStringLiteral("שלג \u2603");
    r.amount = 99.99;
    r.foreignAmount = 0;
    r.currencyCode = QStringLiteral("ש\"ח");
    r.balance = 99.99;
    r.costCode = QStringLiteral("\",'");
    r.fullMatch = 1;
    r.currencyId = 1;
    r.detail = detail(2, QStringLiteral("3001"), QString());
    return r;
}

void setCompanies(ModuleState& state, const QStringList& dirs) {
    state.CompanyDirList = QStringList{QString()} + dirs;
    state.CompanyDirCount = static_cast<int>(dirs.size());
}

ReportScreen plainScreen() {
    ReportScreen s;
    s.accountKey = QStringLiteral("1001");
    s.accountName = QStringLiteral("לקוח א");
    return s;
}

enum class Rows { None, OneCompany, TwoCompaniesSorted };

void fillLedger(LedgerModel& ledger, Rows rows) {
    ledger.clear();
    if (rows == Rows::None)
        return;
    ledger.append(rowA());
    if (rows == Rows::TwoCompaniesSorted) {
        // Read order A, B (company 1) then C (company 2); sorting by the
        // transaction column leaves company 1 on both sides of company 2.
        ledger.append(rowB());
        ledger.append(rowC());
        ledger.sortNumeric(3);
        return;
    }
    ledger.append(rowB());
}

} // namespace

class TestReports : public QObject {
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void init();

    void statement_data();
    void statement();
    void statementHeadingSkipsOnlyEmptyValues();

    void csv_data();
    void csv();
    void csvPage();
    void rowReadMatchesCellByCell();
    void csvRowsMatchCellByCell();

    void graph_data();
    void graph();
    void graphWithNothingToDrawWritesNothing_data();
    void graphWithNothingToDrawWritesNothing();

    void commandShowsThePageInANewWindow();
    void commandFailureShowsMessageAndNoWindow();
    void nothingToDrawIsAnInformationMessage();
    void outputPathIsInTheTemporaryDirectory();
    void writerReplacesAnExistingFile();

    void cardPrintButtonShowsTheStatement();
    void cardExcelButtonShowsTheLinkPage();
    void cardGraphButtonShowsTheGraph();
    void cardGraphButtonWithNothingToDrawOpensNoWindow();
    void cardPrintFailureShowsMessageAndNoWindow();

private:
    QTemporaryDir tmp_;
    host::MessageRecorder messages_;
    host::PageWindowRecorder windows_;
    std::unique_ptr<host::ScopedSeams> seams_;
};

void TestReports::initTestCase() {
    QVERIFY(tmp_.isValid());
    qputenv("TMPDIR", QFile::encodeName(tmp_.path()));
    // The card loads its stored options on creation: keep them in here.
    qputenv("XDG_CONFIG_HOME", QFile::encodeName(tmp_.filePath(QStringLiteral("config"))));
    seams_ = std::make_unique<host::ScopedSeams>(&messages_, &windows_);
}

void TestReports::init() {
    messages_.clear();
    windows_.clear();
    moduleState() = ModuleState{};
}

void TestReports::statement_data() {
    QTest::addColumn<int>("rows");
    QTest::addColumn<bool>("details");
    QTest::addColumn<QString>("reference");

    QTest::newRow("no data rows, details off")
        << int(Rows::None) << false << QStringLiteral("statement_no_rows.htm");
    QTest::newRow("details on, one space and one empty value")
        << int(Rows::OneCompany) << true << QStringLiteral("statement_details_on.htm");
    QTest::newRow("two companies, not consecutive after a sort")
        << int(Rows::TwoCompaniesSorted) << false << QStringLiteral("statement_two_companies.htm");
}

void TestReports::statement() {
    QFETCH(int, rows);
    QFETCH(bool, details);
    QFETCH(QString, reference);

    ModuleState& state = moduleState();
    state.company.ShortName = QStringLiteral("  חברת הדגמה  ");
    LedgerModel ledger;
    fillLedger(ledger, Rows(rows));
    ReportScreen screen = plainScreen();
    screen.showHeadDetails = details;
    screen.balance = QStringLiteral("1,200.00");
    screen.shipBalance = QStringLiteral("0.00");
    screen.oblig = QStringLiteral("5,000.00");
    screen.address = QString();             // empty: no row
    screen.telephone = QStringLiteral(" "); // one space: a row
    screen.details = QStringLiteral("פרטי <לקוח>");

    // Currency 1 has a code but a zero total and is left out; the last id
    // has a total too small to show but not exactly zero.
    state.CurrencyCodes[1] = QStringLiteral("ש\"ח");
    state.CurrencyCodes[2] = QStringLiteral("USD");
    state.CurrencyCodes[5] = QStringLiteral("EUR");
    state.CurrencyCodes[22] = QStringLiteral("JPY");
    if (Rows(rows) == Rows::OneCompany) {
        setCompanies(state, {QStringLiteral("C:\\Ardeco\\A&B")});
        state.CurrencyTotals[2] = 249.75;
        state.CurrencyTotals[5] = -1234.5;
        state.CurrencyTotals[22] = 0.001;
    } else if (Rows(rows) == Rows::TwoCompaniesSorted) {
        setCompanies(state, {QStringLiteral("C:\\Ardeco\\A&B"), QStringLiteral("D:\\שנה 2024")});
        state.CurrencyTotals[1] = 99.99;
    } else {
        setCompanies(state, {QStringLiteral("C:\\Ardeco\\A&B")});
    }

    const QString path = OutputPath(kStatementFile);
    WriteStatement(path, ledger, state, screen);
    compareWithReference(path, reference);
}

void TestReports::statementHeadingSkipsOnlyEmptyValues() {
    const QString path = tmp_.filePath(QStringLiteral("heading.htm"));
    {
        TextFileWriter file(path, TextFileWriter::Unmappable::CharacterReference);
        WriteStatementHeading(file, QStringLiteral(":טלפון"), QString());
        WriteStatementHeading(file, QStringLiteral(":כתובת"), QStringLiteral("  "));
        file.close();
    }
    QCOMPARE(actualText(path),
             QStringLiteral("  <tr>\r\n"
                            "     <td width='70%' align='right'><b>  </b></td>\r\n"
                            "     <td width='30%' align='right'><b>:כתובת</b></td>\r\n"
                            "  </tr>\r\n"));
}

void TestReports::csv_data() {
    QTest::addColumn<int>("rows");
    QTest::addColumn<bool>("names");
    QTest::addColumn<QString>("reference");

    QTest::newRow("no data rows: header only")
        << int(Rows::None) << false << QStringLiteral("csv_no_rows.csv");
    QTest::newRow("one company, names off: 14 fields")
        << int(Rows::OneCompany) << false << QStringLiteral("csv_rows.csv");
    QTest::newRow("one company, names on: 15 fields")
        << int(Rows::OneCompany) << true << QStringLiteral("csv_rows_names.csv");
    QTest::newRow("two companies, names on: 16 fields")
        << int(Rows::TwoCompaniesSorted) << true << QStringLiteral("csv_two_companies.csv");
    QTest::newRow("two companies, names off: header matches the rows")
        << int(Rows::TwoCompaniesSorted) << false
        << QStringLiteral("csv_two_companies_no_names.csv");
}

void TestReports::csv() {
    QFETCH(int, rows);
    QFETCH(bool, names);
    QFETCH(QString, reference);

    ModuleState& state = moduleState();
    if (Rows(rows) == Rows::TwoCompaniesSorted)
        setCompanies(state, {QStringLiteral("C:\\Ardeco\\A&B"), QStringLiteral("D:\\שנה 2024")});
    else
        setCompanies(state, {QStringLiteral("C:\\Ardeco\\A&B")});
    LedgerModel ledger;
    fillLedger(ledger, Rows(rows));

    const QString path = OutputPath(kCsvFile);
    WriteCsv(path, ledger, state, names);
    compareWithReference(path, reference);
}

void TestReports::csvPage() {
    const QString path = OutputPath(kCsvPageFile);
    WriteCsvPage(path, QStringLiteral("/tmp/דוחות & 'שנה'/vltrans1.csv"));
    compareWithReference(path, QStringLiteral("csv_page.htm"));
}

void TestReports::graph_data() {
    QTest::addColumn<int>("kind");
    QTest::addColumn<QString>("shortName");
    QTest::addColumn<QString>("accountKey");
    QTest::addColumn<QString>("accountName");
    QTest::addColumn<QString>("reference");

    QTest::newRow("months: 300 and -150, 0.4, a year after 2025")
        << 1 << QStringLiteral(" חברת הדגמה ") << QStringLiteral("1001")
        << QStringLiteral("לקוח <א>") << QStringLiteral("graph_month.htm");
    QTest::newRow("weeks: no short name, no account key")
        << 0 << QStringLiteral("   ") << QString() << QStringLiteral("לקוח א")
        << QStringLiteral("graph_week.htm");
    QTest::newRow("quarters: large amounts, fractions, 2030")
        << 2 << QStringLiteral("חברת הדגמה") << QStringLiteral("1001") << QStringLiteral("לקוח א")
        << QStringLiteral("graph_quarter.htm");
}

void TestReports::graph() {
    QFETCH(int, kind);
    QFETCH(QString, shortName);
    QFETCH(QString, accountKey);
    QFETCH(QString, accountName);
    QFETCH(QString, reference);

    PeriodTotals totals;
    switch (kind) {
    case PeriodTotals::Month:
        totals.add(QDate(2024, 5, 10), 300);
        totals.add(QDate(2024, 3, 3), -150);
        totals.add(QDate(2024, 1, 20), 0.4);
        totals.add(QDate(2027, 2, 14), 75);
        break;
    case PeriodTotals::Week:
        totals.add(QDate(2024, 3, 5), 300);    // week 10
        totals.add(QDate(2024, 12, 31), -150); // week 53
        break;
    default:
        totals.add(QDate(2030, 1, 15), 2500000);
        totals.add(QDate(2025, 11, 20), 1000.6);
        totals.add(QDate(2025, 5, 1), -1250000);
        break;
    }

    const QString path = OutputPath(kGraphFile);
    QVERIFY(GraphHasBars(totals, kind));
    QVERIFY(WriteGraph(path, totals, kind, shortName, accountKey, accountName));
    compareWithReference(path, reference);
}

void TestReports::graphWithNothingToDrawWritesNothing_data() {
    QTest::addColumn<int>("kind");
    QTest::addColumn<bool>("otherKindsFilled");

    QTest::newRow("empty table") << 1 << false;
    QTest::newRow("amounts that cancel out") << 2 << true;
    QTest::newRow("no such kind") << 3 << true;
}

void TestReports::graphWithNothingToDrawWritesNothing() {
    QFETCH(int, kind);
    QFETCH(bool, otherKindsFilled);

    PeriodTotals totals;
    if (otherKindsFilled) {
        // Two lines in different months of one quarter: the quarter nets to 0.
        totals.add(QDate(2024, 1, 10), 500);
        totals.add(QDate(2024, 2, 10), -500);
    }
    const QString path = tmp_.filePath(QStringLiteral("earlier-graph.htm"));
    {
        QFile earlier(path);
        QVERIFY(earlier.open(QIODevice::WriteOnly));
        earlier.write("earlier");
    }
    QVERIFY(!GraphHasBars(totals, kind));
    QVERIFY(!WriteGraph(path, totals, kind, QStringLiteral("x"), QStringLiteral("1"),
                        QStringLiteral("y")));
    QFile earlier(path);
    QVERIFY(earlier.open(QIODevice::ReadOnly));
    QCOMPARE(earlier.readAll(), QByteArray("earlier"));
}

void TestReports::commandShowsThePageInANewWindow() {
    const QString path = OutputPath(kCsvPageFile);
    QVERIFY(RunOutputCommand([&] { WriteCsvPage(path, QStringLiteral("a.csv")); }, path));
    QVERIFY(messages_.messages().isEmpty());
    QCOMPARE(windows_.windows().size(), 1);
    QCOMPARE(windows_.windows().at(0), QStringList{path});
}

void TestReports::commandFailureShowsMessageAndNoWindow() {
    // A directory where the file should be: the file cannot be replaced.
    const QString path = tmp_.filePath(QStringLiteral("blocked.htm"));
    QVERIFY(QDir().mkpath(path + QStringLiteral("/inner")));
    QString description;
    try {
        WriteCsvPage(path, QStringLiteral("a.csv"));
    } catch (const Failure& failure) {
        description = failure.description();
    }
    QVERIFY(!description.isEmpty());

    QVERIFY(!RunOutputCommand([&] { WriteCsvPage(path, QStringLiteral("a.csv")); }, path));
    QCOMPARE(messages_.messages().size(), 1);
    const host::Message& m = messages_.messages().at(0);
    QCOMPARE(m.title, QStringLiteral("תקלה"));
    QCOMPARE(m.text, description);
    QCOMPARE(m.icon, host::MessageIcon::Critical);
    QVERIFY(windows_.windows().isEmpty());
}

void TestReports::nothingToDrawIsAnInformationMessage() {
    ReportNothingToDraw();
    QCOMPARE(messages_.messages().size(), 1);
    QCOMPARE(messages_.messages().at(0).icon, host::MessageIcon::Information);
    QCOMPARE(messages_.messages().at(0).title, QStringLiteral("גרף"));
    QCOMPARE(messages_.messages().at(0).text, QStringLiteral("אין נתונים להצגה בגרף"));
    QVERIFY(windows_.windows().isEmpty());
}

void TestReports::outputPathIsInTheTemporaryDirectory() {
    QCOMPARE(OutputPath(kStatementFile), tmp_.path() + QStringLiteral("/vlprint.htm"));
    QCOMPARE(OutputPath(kCsvFile), tmp_.path() + QStringLiteral("/vltrans1.csv"));
    QCOMPARE(OutputPath(kCsvPageFile), tmp_.path() + QStringLiteral("/vltrans1.htm"));
    QCOMPARE(OutputPath(kGraphFile), tmp_.path() + QStringLiteral("/vtransg.htm"));
}

void TestReports::writerReplacesAnExistingFile() {
    const QString path = OutputPath(kCsvFile);
    {
        QFile old(path);
        QVERIFY(old.open(QIODevice::WriteOnly));
        old.write(QByteArray(4096, 'x'));
    }
    ModuleState& state = moduleState();
    setCompanies(state, {QStringLiteral("c1")});
    LedgerModel ledger;
    WriteCsv(path, ledger, state, false);
    compareWithReference(path, QStringLiteral("csv_no_rows.csv"));
}

namespace {

// A card on show with the fixture's account, its grid filled as a fetch
// leaves it, the output buttons enabled.
struct CardOnShow {
    Card card;
    CardOnShow() {
        set(QStringLiteral("txtAccountKey"), QStringLiteral("1001"));
        set(QStringLiteral("txtAccountName"), QStringLiteral("לקוח א"));
        set(QStringLiteral("txtBalance"), QStringLiteral("1,200.00"));
        set(QStringLiteral("txtShipBalance"), QStringLiteral("0.00"));
        set(QStringLiteral("txtOblig"), QStringLiteral("5,000.00"));
        set(QStringLiteral("txtAddress"), QString());
        set(QStringLiteral("txtTelephone"), QStringLiteral(" "));
        set(QStringLiteral("txtDetails"), QStringLiteral("פרטי <לקוח>"));
        auto* ledger = card.findChild<LedgerModel*>();
        if (ledger)
            fillLedger(*ledger, Rows::OneCompany);
        card.EnableButtons(true);
    }
    void set(const QString& name, const QString& text) {
        if (auto* box = card.findChild<QLineEdit*>(name))
            box->setText(text);
    }
    void click(const QString& name) {
        if (auto* button = card.findChild<QPushButton*>(name))
            button->click();
    }
};

// The module state a fetch of the fixture leaves: one company whose
// details cannot be read again (its short name stays), the currency totals.
void setFetchedState() {
    ModuleState& state = moduleState();
    state.CompanyDirText = QStringLiteral("no-such-company.db");
    setCompanies(state, {QStringLiteral("C:\\Ardeco\\A&B")});
    state.company.ShortName = QStringLiteral("  חברת הדגמה  ");
    state.CurrencyCodes[1] = QStringLiteral("ש\"ח");
    state.CurrencyCodes[2] = QStringLiteral("USD");
    state.CurrencyCodes[5] = QStringLiteral("EUR");
    state.CurrencyCodes[22] = QStringLiteral("JPY");
    state.CurrencyTotals[2] = 249.75;
    state.CurrencyTotals[5] = -1234.5;
    state.CurrencyTotals[22] = 0.001;
}

} // namespace

void TestReports::cardPrintButtonShowsTheStatement() {
    setFetchedState();
    CardOnShow shown;
    QVERIFY(shown.card.findChild<LedgerModel*>());
    shown.card.findChild<QCheckBox*>(QStringLiteral("chkShowHeadDetails"))->setChecked(true);
    shown.click(QStringLiteral("PrintButt"));

    const QString path = OutputPath(kStatementFile);
    QVERIFY(messages_.messages().isEmpty());
    QCOMPARE(windows_.windows().size(), 1);
    QCOMPARE(windows_.windows().at(0), QStringList{path});
    compareWithReference(path, QStringLiteral("statement_details_on.htm"));
}

void TestReports::cardExcelButtonShowsTheLinkPage() {
    setFetchedState();
    CardOnShow shown;
    shown.card.findChild<QCheckBox*>(QStringLiteral("chkNegdiName"))->setChecked(true);
    shown.click(QStringLiteral("ExcelButt"));

    const QString page = OutputPath(kCsvPageFile);
    QVERIFY(messages_.messages().isEmpty());
    QCOMPARE(windows_.windows().size(), 1);
    QCOMPARE(windows_.windows().at(0), QStringList{page});
    compareWithReference(OutputPath(kCsvFile), QStringLiteral("csv_rows_names.csv"));
    const QString link = QStringLiteral("<A HREF='") + OutputPath(kCsvFile) + u'\'';
    QVERIFY(actualText(page).contains(link));
}

void TestReports::cardGraphButtonShowsTheGraph() {
    setFetchedState();
    moduleState().company.ShortName = QStringLiteral(" חברת הדגמה ");
    PeriodTotals& totals = moduleState().periods;
    totals.add(QDate(2024, 5, 10), 300);
    totals.add(QDate(2024, 3, 3), -150);
    totals.add(QDate(2024, 1, 20), 0.4);
    totals.add(QDate(2027, 2, 14), 75);
    CardOnShow shown;
    shown.set(QStringLiteral("txtAccountName"), QStringLiteral("לקוח <א>"));
    shown.card.findChild<QComboBox*>(QStringLiteral("CmbGraphType"))->setCurrentIndex(1);
    shown.click(QStringLiteral("CmdGraph"));

    const QString path = OutputPath(kGraphFile);
    QVERIFY(messages_.messages().isEmpty());
    QCOMPARE(windows_.windows().size(), 1);
    QCOMPARE(windows_.windows().at(0), QStringList{path});
    compareWithReference(path, QStringLiteral("graph_month.htm"));
}

void TestReports::cardGraphButtonWithNothingToDrawOpensNoWindow() {
    setFetchedState();
    QFile::remove(OutputPath(kGraphFile));
    CardOnShow shown;
    shown.card.findChild<QComboBox*>(QStringLiteral("CmbGraphType"))->setCurrentIndex(0);
    shown.click(QStringLiteral("CmdGraph"));

    QCOMPARE(messages_.messages().size(), 1);
    QCOMPARE(messages_.messages().at(0).icon, host::MessageIcon::Information);
    QVERIFY(windows_.windows().isEmpty());
    QVERIFY(!QFile::exists(OutputPath(kGraphFile)));
}

void TestReports::cardPrintFailureShowsMessageAndNoWindow() {
    setFetchedState();
    const QString path = OutputPath(kStatementFile);
    QFile::remove(path);
    QVERIFY(QDir().mkpath(path + QStringLiteral("/inner")));
    CardOnShow shown;
    shown.click(QStringLiteral("PrintButt"));
    QDir(path).removeRecursively();

    QCOMPARE(messages_.messages().size(), 1);
    QCOMPARE(messages_.messages().at(0).title, QStringLiteral("תקלה"));
    QCOMPARE(messages_.messages().at(0).icon, host::MessageIcon::Critical);
    QVERIFY(!messages_.messages().at(0).text.isEmpty());
    QVERIFY(windows_.windows().isEmpty());
}

void TestReports::rowReadMatchesCellByCell() {
    // Rows whose cells take every way of formatting: integers and text as
    // batch numbers, fractions in the references, dates out of the quick
    // range and none, amounts beyond the fast range.
    LedgerModel ledger;
    ledger.append(rowA());
    ledger.append(rowB());
    ledger.append(rowC());
    LedgerRow odd = rowA();
    odd.batchNo = QStringLiteral("B-7");
    odd.transId = 12.5;
    odd.referance = 1.25;
    odd.ref2 = 1e16;
    odd.valueDate = QDate(999, 12, 31);
    odd.dueDate = QDate();
    odd.amount = -1e15;
    odd.foreignAmount = -0.004;
    odd.balance = 1234567.891;
    ledger.append(odd);
    LedgerModel::RowCells grouped;
    LedgerModel::RowCells plain;
    for (int r = 1; r <= ledger.gridRowCount() - 2; ++r) {
        ledger.readRow(r, LedgerModel::kColumns - 1, LedgerModel::MoneyText::Grouped, grouped);
        ledger.readRow(r, LedgerModel::kColumns - 1, LedgerModel::MoneyText::Plain, plain);
        for (int c = 0; c < LedgerModel::kColumns; ++c) {
            const QString text = ledger.cellText(r, c);
            QString withoutCommas = text;
            if (c == 8 || c == 9 || c == 11)
                withoutCommas.remove(u',');
            auto asText = [](const LedgerModel::CellView& v) {
                return v.isAscii ? QString::fromLatin1(v.ascii.data(),
                                                       static_cast<qsizetype>(v.ascii.size()))
                                 : v.text.toString();
            };
            QCOMPARE(asText(grouped.cell[c]), text);
            QCOMPARE(asText(plain.cell[c]), withoutCommas);
            if (plain.cell[c].isAscii)
                QVERIFY(plain.cell[c].ascii.find(',') == std::string_view::npos);
        }
    }
    // The amounts of the odd row, written out.
    QCOMPARE(plain.cell[8].ascii, std::string_view("-1000000000000000.00"));
    QCOMPARE(plain.cell[9].ascii, std::string_view("0.00"));
    QCOMPARE(plain.cell[11].ascii, std::string_view("1234567.89"));
    QCOMPARE(grouped.cell[11].ascii, std::string_view("1,234,567.89"));
    // Outside the data rows every cell is empty.
    ledger.readRow(0, 12, LedgerModel::MoneyText::Plain, plain);
    QVERIFY(!plain.cell[3].isAscii && plain.cell[3].text.isEmpty());
}

namespace {
// A text of up to 12 characters from ASCII letters, Hebrew letters, spaces
// and the separators a CSV field drops.
QString randomText(std::mt19937& random) {
    static const char16_t kAlphabet[] = u"aZ9 .-,'\"אבגשת";
    QString text;
    const auto length = random() % 13;
    for (unsigned i = 0; i < length; ++i)
        text += QChar(kAlphabet[random() % (std::size(kAlphabet) - 1)]);
    return text;
}

double randomAmount(std::mt19937& random) {
    switch (random() % 6) {
    case 0:
        return 0;
    case 1:
        return -static_cast<double>(random() % 100000) / 100.0;
    case 2:
        return static_cast<double>(random()) * 1234.5678; // beyond 1e7 often
    case 3:
        return -1e15 - static_cast<double>(random() % 1000); // beyond the fast range
    default:
        return static_cast<double>(random() % 10000000) / 1000.0; // halves and thirds
    }
}

// Mostly rows of plain typed values, some with a value only the general
// conversion formats.
LedgerRow randomRow(std::mt19937& random, int number) {
    LedgerRow r;
    r.rowNumber = number % 7 == 0 ? -number : number;
    r.valueDate = QDate(2024, 1, 1).addDays(number / 5);
    r.dueDate = QDate(1990, 6, 1).addDays(static_cast<qint64>(random() % 20000));
    r.batchNo = static_cast<int>(random() % 5000);
    r.transId = static_cast<qlonglong>(random());
    r.referance = static_cast<double>(random() % 100000);
    r.ref2 = -static_cast<double>(random() % 1000);
    switch (random() % 12) {
    case 0:
        r.batchNo = QStringLiteral("B,7'");
        break;
    case 1:
        r.transId = 12.5;
        break;
    case 2:
        r.referance = 1.25;
        break;
    case 3:
        r.ref2 = 1e16;
        break;
    case 4:
        r.valueDate = QDate(999, 12, 31);
        break;
    case 5:
        r.dueDate = QDate();
        break;
    case 6:
        r.batchNo = QVariant();
        break;
    case 7:
        r.transId = 7u;
        break;
    default:
        break;
    }
    r.description = randomText(random);
    r.amount = randomAmount(random);
    r.foreignAmount = randomAmount(random);
    r.currencyCode = randomText(random);
    r.balance = randomAmount(random);
    r.costCode = randomText(random);
    r.detail = detail(static_cast<int>(random() % 3), randomText(random), randomText(random));
    return r;
}
} // namespace

void TestReports::csvRowsMatchCellByCell() {
    // Random rows, enough of them that the writer's buffer fills and goes
    // to the file several times in the middle of rows: every line is the
    // grid's own cell texts without the separators a field may not carry.
    ModuleState& state = moduleState();
    setCompanies(state, {QStringLiteral("C:\\Ardeco\\A,B"), QStringLiteral("D:\\שנה")});
    LedgerModel ledger;
    std::mt19937 random(41);
    for (int i = 1; i <= 40000; ++i)
        ledger.stage(randomRow(random, i));
    ledger.commitStaged();

    const QString path = OutputPath(kCsvFile);
    WriteCsv(path, ledger, state, true);
    const QStringList lines = actualText(path).split(QStringLiteral("\r\n"));
    QCOMPARE(lines.size(), ledger.dataRowCount() + 2); // header, rows, and the last line end
    auto stripped = [](QString text) {
        text.remove(u'"');
        text.remove(u'\'');
        text.remove(u',');
        return text;
    };
    for (int r = 1; r <= ledger.dataRowCount(); ++r) {
        QStringList fields;
        for (int c = 0; c <= 12; ++c)
            fields << stripped(ledger.cellText(r, c));
        const RowDetail& d = ledger.rowDetail(r);
        fields << stripped(d.CounterKey) << stripped(d.CounterName)
               << stripped(state.CompanyDirList.at(d.CompIndex));
        QCOMPARE(lines.at(r), fields.join(u','));
    }
    QVERIFY(lines.last().isEmpty());
}

QTEST_MAIN(TestReports)
#include "test_reports.moc"
