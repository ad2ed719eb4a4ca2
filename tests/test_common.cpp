// Shared helpers: quote stripping, company-directory splitting, Null
// helpers, number and date formats, HTML escaping, the windows-1255 writer.
#include "common/decimal_digits.h"
#include "common/failure.h"
#include "common/formats.h"
#include "common/html_escape.h"
#include "common/module_state.h"
#include "common/period_totals.h"
#include "common/text_file_writer.h"
#include "common/text_helpers.h"

#include <QFile>
#include <QTemporaryDir>
#include <QtTest>
#include <cmath>
#include <limits>
#include <random>
#include <string>
#include <unicode/ucnv.h>
#include <vector>

using namespace ardcard;

class TestCommon : public QObject {
    Q_OBJECT
private Q_SLOTS:
    void stripQuotes_data();
    void stripQuotes();
    void splitCompanyDirs_data();
    void splitCompanyDirs();
    void splitKeepsListWhenEmpty();
    void splitManyEntries();
    void nullHelpers();
    void plainNumber_data();
    void plainNumber();
    void money_data();
    void money();
    void quantityAndWhole_data();
    void quantityAndWhole();
    void dates();
    void toDate_data();
    void toDate();
    void htmlEscape();
    void weekOfYear_data();
    void weekOfYear();
    void periodTotalsUnbounded();
    void writerHebrewBytes();
    void writerUnmappable_data();
    void writerUnmappable();
    void writerReplacesExistingFile();
    void writerFailsOnMissingDirectory();
    void writerLargeOutput();
    void moduleStateIsPerThread();
    void fastRoundingMatchesDecimalDigits();
    void groupedTextMatchesDecimalDigits();
    void plainWholeMatchesPlainNumber();
    void quickDatesMatchCalendar();
    void writerMatchesIcuForEveryUnit_data();
    void writerMatchesIcuForEveryUnit();
    void writerSurrogatesAcrossPieces();
    void writerRewriteMatchesHtmlEscape();
    void writerAsciiAndClosed();
    void plainMoneyIsMoneyWithoutCommas_data();
    void plainMoneyIsMoneyWithoutCommas();
    void plainMoneyMatchesGroupedText();
    void writerBlocksMatchIcuForEveryUnit_data();
    void writerBlocksMatchIcuForEveryUnit();
    void writerAsciiPiecesOfEverySize();
    void writerShortPiecesMatchGeneralPath_data();
    void writerShortPiecesMatchGeneralPath();
    void integerTextAtEveryLength();
};

void TestCommon::stripQuotes_data() {
    QTest::addColumn<QVariant>("value");
    QTest::addColumn<QString>("expected");
    QTest::newRow("plain") << QVariant(QStringLiteral("1001")) << QStringLiteral("1001");
    QTest::newRow("quotes and commas")
        << QVariant(QStringLiteral("12'3,\"4\"")) << QStringLiteral("1234");
    QTest::newRow("only quotes") << QVariant(QStringLiteral("'\",,'")) << QString();
    QTest::newRow("null") << QVariant() << QString();
    QTest::newRow("empty") << QVariant(QString()) << QString();
    QTest::newRow("hebrew kept") << QVariant(QStringLiteral("חשב'ון")) << QStringLiteral("חשבון");
    QTest::newRow("number") << QVariant(42) << QStringLiteral("42");
}

void TestCommon::stripQuotes() {
    QFETCH(QVariant, value);
    QFETCH(QString, expected);
    QCOMPARE(StripQuotes(value), expected);
}

void TestCommon::splitCompanyDirs_data() {
    QTest::addColumn<QString>("text");
    QTest::addColumn<QStringList>("entries");
    QTest::newRow("three mixed") << QStringLiteral("a.db;b.db,c.db")
                                 << QStringList{QStringLiteral("a.db"), QStringLiteral("b.db"),
                                                QStringLiteral("c.db")};
    QTest::newRow("separators at ends and doubled")
        << QStringLiteral(";;a;,b,;") << QStringList{QStringLiteral("a"), QStringLiteral("b")};
    QTest::newRow("one") << QStringLiteral("demo.db") << QStringList{QStringLiteral("demo.db")};
    QTest::newRow("spaces are kept")
        << QStringLiteral(" a ; b") << QStringList{QStringLiteral(" a "), QStringLiteral(" b")};
}

void TestCommon::splitCompanyDirs() {
    QFETCH(QString, text);
    QFETCH(QStringList, entries);
    QStringList list{QString(), QStringLiteral("old1"), QStringLiteral("old2"),
                     QStringLiteral("old3"), QStringLiteral("old4")};
    QCOMPARE(SplitCompanyDirs(text, list), entries.size());
    QCOMPARE(list, QStringList{QString()} + entries);
}

void TestCommon::splitKeepsListWhenEmpty() {
    const QStringList before{QString(), QStringLiteral("x.db")};
    for (const QString& text : {QString(), QStringLiteral(";,;")}) {
        QStringList list = before;
        QCOMPARE(SplitCompanyDirs(text, list), 0);
        QCOMPARE(list, before);
    }
}

void TestCommon::splitManyEntries() {
    // Far past 16 bits of text and past 255 entries.
    QStringList parts;
    for (int i = 0; i < 40000; ++i)
        parts.append(QStringLiteral("c%1").arg(i));
    QStringList list;
    QCOMPARE(SplitCompanyDirs(parts.join(u';'), list), 40000);
    QCOMPARE(list.at(40000), QStringLiteral("c39999"));
}

void TestCommon::nullHelpers() {
    QCOMPARE(NullToText(QVariant(), QStringLiteral(" ")), QStringLiteral(" "));
    QCOMPARE(NullToText(QVariant(QStringLiteral("x")), QStringLiteral("-")), QStringLiteral("x"));
    QCOMPARE(NullToText(QVariant(QString()), QStringLiteral("-")), QString());
    QCOMPARE(NullToZero(QVariant()), 0.0);
    QCOMPARE(NullToZero(QVariant(QStringLiteral("12.5"))), 12.5);
    QCOMPARE(NullToZero(QVariant(7)), 7.0);
    QCOMPARE(NullToNbsp(QVariant()), QStringLiteral("&nbsp;"));
    QCOMPARE(NullToNbsp(QVariant(QString())), QString());
    QCOMPARE(NullToNbsp(QVariant(1234.5)), QStringLiteral("1234.5"));
    QCOMPARE(NullToNbsp(QVariant(2.0)), QStringLiteral("2"));
    QCOMPARE(NullToNbsp(QVariant(QStringLiteral("<b>"))), QStringLiteral("<b>"));
}

void TestCommon::plainNumber_data() {
    QTest::addColumn<double>("value");
    QTest::addColumn<QString>("expected");
    QTest::newRow("whole") << 2.0 << QStringLiteral("2");
    QTest::newRow("fraction") << 1234.5 << QStringLiteral("1234.5");
    QTest::newRow("tenth") << 0.1 << QStringLiteral("0.1");
    QTest::newRow("zero") << 0.0 << QStringLiteral("0");
    QTest::newRow("negative zero") << -0.0 << QStringLiteral("0");
    QTest::newRow("negative") << -17.25 << QStringLiteral("-17.25");
    QTest::newRow("sum noise trimmed at 15 digits") << (0.1 + 0.2) << QStringLiteral("0.3");
    QTest::newRow("large, no exponent") << 1e15 << QStringLiteral("1000000000000000");
    QTest::newRow("small, no exponent") << 0.00012 << QStringLiteral("0.00012");
    QTest::newRow("15 significant digits")
        << 123456789.123456789 << QStringLiteral("123456789.123457");
}

void TestCommon::plainNumber() {
    QFETCH(double, value);
    QFETCH(QString, expected);
    QCOMPARE(PlainNumber(value), expected);
}

void TestCommon::money_data() {
    QTest::addColumn<double>("value");
    QTest::addColumn<QString>("expected");
    QTest::newRow("negative grouped") << -1234.5 << QStringLiteral("-1,234.50");
    QTest::newRow("zero") << 0.0 << QStringLiteral("0.00");
    QTest::newRow("negative zero") << -0.0 << QStringLiteral("0.00");
    QTest::newRow("99") << 99.0 << QStringLiteral("99.00");
    QTest::newRow("million") << 1234567.891 << QStringLiteral("1,234,567.89");
    QTest::newRow("half away from zero") << 2.345 << QStringLiteral("2.35");
    QTest::newRow("negative half away from zero") << -2.345 << QStringLiteral("-2.35");
    QTest::newRow("binary 1.005 rounds up") << 1.005 << QStringLiteral("1.01");
    QTest::newRow("tiny negative is zero") << -0.001 << QStringLiteral("0.00");
    QTest::newRow("carry into thousands") << 999.995 << QStringLiteral("1,000.00");
    QTest::newRow("1e15") << 1e15 << QStringLiteral("1,000,000,000,000,000.00");
    QTest::newRow("below one") << 0.5 << QStringLiteral("0.50");
}

void TestCommon::money() {
    QFETCH(double, value);
    QFETCH(QString, expected);
    QCOMPARE(FormatMoney(value), expected);
}

void TestCommon::quantityAndWhole_data() {
    QTest::addColumn<double>("value");
    QTest::addColumn<QString>("quantity");
    QTest::addColumn<QString>("whole");
    QTest::newRow("2") << 2.0 << QStringLiteral("2.000") << QStringLiteral("2");
    QTest::newRow("300") << 300.0 << QStringLiteral("300.000") << QStringLiteral("300");
    QTest::newRow("-150") << -150.0 << QStringLiteral("-150.000") << QStringLiteral("-150");
    QTest::newRow("0.4 prints no digits") << 0.4 << QStringLiteral("0.400") << QString();
    QTest::newRow("0.5 rounds up") << 0.5 << QStringLiteral("0.500") << QStringLiteral("1");
    QTest::newRow("-0.4") << -0.4 << QStringLiteral("-0.400") << QString();
    QTest::newRow("grouped") << 1234567.5 << QStringLiteral("1,234,567.500")
                             << QStringLiteral("1,234,568");
    QTest::newRow("zero") << 0.0 << QStringLiteral("0.000") << QString();
}

void TestCommon::quantityAndWhole() {
    QFETCH(double, value);
    QFETCH(QString, quantity);
    QFETCH(QString, whole);
    QCOMPARE(FormatQuantity(value), quantity);
    QCOMPARE(FormatWhole(value), whole);
}

void TestCommon::dates() {
    QCOMPARE(FormatShortDate(QDate(2004, 3, 7)), QStringLiteral("07/03/04"));
    QCOMPARE(FormatLongDate(QDate(2004, 3, 7)), QStringLiteral("07/03/2004"));
    QCOMPARE(FormatShortDate(QDate(1900, 12, 31)), QStringLiteral("31/12/00"));
    QCOMPARE(FormatLongDate(QDate(2100, 1, 1)), QStringLiteral("01/01/2100"));
}

void TestCommon::toDate_data() {
    QTest::addColumn<QVariant>("value");
    QTest::addColumn<QDate>("expected");
    QTest::newRow("date") << QVariant(QDate(2020, 2, 29)) << QDate(2020, 2, 29);
    QTest::newRow("date time") << QVariant(QDateTime(QDate(2020, 2, 29), QTime(10, 0)))
                               << QDate(2020, 2, 29);
    QTest::newRow("iso text") << QVariant(QStringLiteral("2020-02-29")) << QDate(2020, 2, 29);
    QTest::newRow("iso text with time")
        << QVariant(QStringLiteral("2020-02-29 00:00:00")) << QDate(2020, 2, 29);
    QTest::newRow("iso T") << QVariant(QStringLiteral("2020-02-29T12:30:00")) << QDate(2020, 2, 29);
    QTest::newRow("null") << QVariant() << QDate();
    QTest::newRow("not a date") << QVariant(QStringLiteral("2020-02-30")) << QDate();
    QTest::newRow("free text") << QVariant(QStringLiteral("yesterday morning")) << QDate();
}

void TestCommon::toDate() {
    QFETCH(QVariant, value);
    QFETCH(QDate, expected);
    QCOMPARE(ToDate(value), expected);
}

void TestCommon::htmlEscape() {
    QCOMPARE(HtmlEscape(QStringLiteral("<b>A & B</b>")),
             QStringLiteral("&lt;b&gt;A &amp; B&lt;/b&gt;"));
    QCOMPARE(HtmlEscape(QStringLiteral("a'b\"c")), QStringLiteral("a&#39;b&quot;c"));
    QCOMPARE(HtmlEscape(QStringLiteral("שלום")), QStringLiteral("שלום"));
    QCOMPARE(HtmlEscape(QStringLiteral("&nbsp;")), QStringLiteral("&amp;nbsp;"));
}

void TestCommon::weekOfYear_data() {
    QTest::addColumn<QDate>("date");
    QTest::addColumn<int>("week");
    QTest::newRow("31 Dec 2000, leap year starting Saturday") << QDate(2000, 12, 31) << 54;
    QTest::newRow("1 Jan 2000 Saturday") << QDate(2000, 1, 1) << 1;
    QTest::newRow("2 Jan 2000 Sunday starts week 2") << QDate(2000, 1, 2) << 2;
    QTest::newRow("1 Jan 2023 Sunday") << QDate(2023, 1, 1) << 1;
    QTest::newRow("7 Jan 2023 Saturday") << QDate(2023, 1, 7) << 1;
    QTest::newRow("8 Jan 2023 Sunday") << QDate(2023, 1, 8) << 2;
    QTest::newRow("31 Dec 2023") << QDate(2023, 12, 31) << 53;
}

void TestCommon::weekOfYear() {
    QFETCH(QDate, date);
    QFETCH(int, week);
    QCOMPARE(PeriodTotals::weekOfYear(date), week);
}

void TestCommon::periodTotalsUnbounded() {
    PeriodTotals totals;
    totals.add(QDate(2026, 1, 1), 100.0);
    totals.add(QDate(1989, 5, 20), -40.0);
    totals.add(QDate(2000, 12, 31), 7.5);
    totals.add(QDate(2000, 12, 30), -7.5); // same month and quarter, week 53
    QCOMPARE(totals.value(PeriodTotals::Month, 2026, 1), 100.0);
    QCOMPARE(totals.value(PeriodTotals::Quarter, 1989, 2), -40.0);
    QCOMPARE(totals.value(PeriodTotals::Week, 2000, 54), 7.5);
    QCOMPARE(totals.value(PeriodTotals::Month, 2000, 12), 0.0);
    QCOMPARE(totals.yearsDescending(PeriodTotals::Month), (std::vector<int>{2026, 1989}));
    QCOMPARE(totals.yearsDescending(PeriodTotals::Week), (std::vector<int>{2026, 2000, 1989}));
    QCOMPARE(totals.value(PeriodTotals::Month, 2026, 13), 0.0);
    QCOMPARE(totals.value(7, 2026, 1), 0.0);
    QCOMPARE(PeriodTotals::periodsPerYear(7), 0);
    totals.clear();
    QVERIFY(totals.yearsDescending(PeriodTotals::Week).empty());
}

namespace {
QByteArray readAll(const QString& path) {
    QFile f(path);
    if (!f.open(QIODevice::ReadOnly))
        return {};
    return f.readAll();
}
} // namespace

void TestCommon::writerHebrewBytes() {
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("page.htm"));
    TextFileWriter w(path, TextFileWriter::Unmappable::CharacterReference);
    w.write(QStringLiteral("<p>"));
    w.write(QStringLiteral("שלום"));
    w.writeLine(QStringLiteral("</p>"));
    w.writeLine(QStringLiteral("₪"));
    w.close();
    // alef-bet in windows-1255: shin F9, lamed EC, vav E5, final mem ED; sheqel sign A4.
    QCOMPARE(readAll(path), QByteArray("<p>\xF9\xEC\xE5\xED</p>\r\n\xA4\r\n"));
}

void TestCommon::writerUnmappable_data() {
    QTest::addColumn<int>("mode");
    QTest::addColumn<QByteArray>("expected");
    QTest::newRow("page") << int(TextFileWriter::Unmappable::CharacterReference)
                          << QByteArray("a&#128512;b&#1589;\r\n");
    QTest::newRow("csv") << int(TextFileWriter::Unmappable::QuestionMark) << QByteArray("a?b?\r\n");
}

void TestCommon::writerUnmappable() {
    QFETCH(int, mode);
    QFETCH(QByteArray, expected);
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("out.txt"));
    TextFileWriter w(path, static_cast<TextFileWriter::Unmappable>(mode));
    // an emoji (outside the BMP) and an Arabic letter
    w.writeLine(QStringLiteral("a") + QString::fromUcs4(U"\U0001F600") + QStringLiteral("b") +
                QChar(0x0635));
    w.close();
    QCOMPARE(readAll(path), expected);
}

void TestCommon::writerReplacesExistingFile() {
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("out.htm"));
    {
        QFile f(path);
        QVERIFY(f.open(QIODevice::WriteOnly));
        f.write("old contents that are much longer than the new ones");
    }
    TextFileWriter w(path, TextFileWriter::Unmappable::CharacterReference);
    w.writeLine(u"new");
    w.close();
    QCOMPARE(readAll(path), QByteArray("new\r\n"));
}

void TestCommon::writerFailsOnMissingDirectory() {
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("no/such/dir/out.htm"));
    try {
        TextFileWriter w(path, TextFileWriter::Unmappable::CharacterReference);
        QFAIL("a file in a missing directory was created");
    } catch (const Failure& f) {
        QVERIFY(f.description().contains(path));
    }
}

void TestCommon::writerLargeOutput() {
    // Past the writer's buffer, with a Hebrew letter straddling the flushes.
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("big.csv"));
    TextFileWriter w(path, TextFileWriter::Unmappable::QuestionMark);
    for (int i = 0; i < 50000; ++i)
        w.writeLine(QStringLiteral("%1,אב").arg(i));
    w.close();
    const QByteArray bytes = readAll(path);
    QCOMPARE(bytes.count("\r\n"), 50000);
    QVERIFY(bytes.endsWith("49999,\xE0\xE1\r\n"));
}

void TestCommon::moduleStateIsPerThread() {
    moduleState().CompanyDirText = QStringLiteral("main.db");
    QString seenInThread = QStringLiteral("unset");
    std::unique_ptr<QThread> thread(QThread::create([&] {
        seenInThread = moduleState().CompanyDirText;
        moduleState().CompanyDirText = QStringLiteral("other.db");
    }));
    thread->start();
    thread->wait();
    QCOMPARE(seenInThread, QString());
    QCOMPARE(moduleState().CompanyDirText, QStringLiteral("main.db"));
    QCOMPARE(companyDir(moduleState(), 5), QString());
}

namespace {

// The general rule, written out once more for the comparisons below: the
// number as 15 significant digits, then half away from zero.
std::string generalScaled(double value, int decimals) {
    return detail::roundedScaled(detail::toDecimalDigits(value), decimals);
}

// Values that make rounding hard: cents and halves of every size, exact
// binary ties at the 16th digit, neighbours of halves one ulp away, powers
// of ten and the edges of the fast range, and plain random doubles.
std::vector<double> hardValues() {
    std::mt19937_64 random(20240611);
    std::vector<double> values = {0.0,
                                  -0.0,
                                  0.005,
                                  0.0049999999999999,
                                  0.00049999999999999,
                                  0.0005,
                                  0.5,
                                  1.005,
                                  2.345,
                                  999.995,
                                  1e-6,
                                  std::nextafter(1e-6, 0.0),
                                  9999999999999.995,
                                  9999999999999.99,
                                  std::nextafter(1e13, 0.0),
                                  1e13,
                                  1234567890123.125,
                                  1234567890123.375,
                                  999999999999999.0,
                                  5e-324,
                                  std::numeric_limits<double>::max(),
                                  std::numeric_limits<double>::infinity(),
                                  std::numeric_limits<double>::quiet_NaN()};
    for (int e = -7; e <= 13; ++e) {
        const double p = std::pow(10.0, e);
        values.insert(values.end(), {p, std::nextafter(p, 0.0), std::nextafter(p, 1e300)});
    }
    std::uniform_int_distribution<long long> digits(0, 999999999999999LL);
    std::uniform_int_distribution<int> scale(0, 18);
    std::uniform_real_distribution<double> unit(0.0, 1.0);
    for (int i = 0; i < 50000; ++i) {
        const long long n = digits(random) >> scale(random);
        const double p = std::pow(10.0, -scale(random) % 6);
        const double half = (static_cast<double>(n) + 0.5) * p; // x.5 at some place
        values.insert(values.end(), {static_cast<double>(n) / 100.0, half,
                                     std::nextafter(half, 0.0), std::nextafter(half, 1e300)});
        // Eighths and sixteenths of large numbers are exact ties at 15 digits.
        const double big = static_cast<double>(digits(random) % 10000000000000LL);
        values.push_back(big + static_cast<double>(i % 16) / 16.0);
        values.push_back(std::ldexp(unit(random), static_cast<int>(i % 70) - 26));
    }
    const size_t count = values.size();
    for (size_t i = 0; i < count; ++i)
        values.push_back(-values[i]);
    return values;
}

// Grouped text built from the general digits by hand, independently of the
// formatter under test.
QString groupedFromDigits(double value, int decimals, bool emptyWhenZero) {
    const detail::DecimalDigits d = detail::toDecimalDigits(value);
    std::string n = detail::roundedScaled(d, decimals);
    if (n == "0" && emptyWhenZero)
        return QString();
    const bool negative = d.negative && n != "0";
    while (n.size() < static_cast<size_t>(decimals) + 1)
        n.insert(n.begin(), '0');
    std::string integer = n.substr(0, n.size() - static_cast<size_t>(decimals));
    std::string grouped;
    for (size_t i = 0; i < integer.size(); ++i) {
        if (i > 0 && (integer.size() - i) % 3 == 0)
            grouped += ',';
        grouped += integer[i];
    }
    if (decimals > 0)
        grouped += '.' + n.substr(integer.size());
    return QString::fromLatin1((negative ? "-" : "") + grouped);
}

} // namespace

void TestCommon::fastRoundingMatchesDecimalDigits() {
    int fast = 0;
    for (const double value : hardValues()) {
        for (int decimals = 0; decimals <= 3; ++decimals) {
            std::uint64_t scaled = 0;
            if (!detail::fastRoundedScaled(value, decimals, scaled))
                continue;
            ++fast;
            if (std::to_string(scaled) != generalScaled(value, decimals))
                QFAIL(qPrintable(QStringLiteral("%1 at %2 decimals: %3, not %4")
                                     .arg(value, 0, 'g', 17)
                                     .arg(decimals)
                                     .arg(scaled)
                                     .arg(QString::fromStdString(generalScaled(value, decimals)))));
        }
    }
    QVERIFY(fast > 1000000); // the fast path really ran
    std::uint64_t scaled = 0;
    QVERIFY(!detail::fastRoundedScaled(1e13, 2, scaled));
    QVERIFY(!detail::fastRoundedScaled(std::nan(""), 2, scaled));
    QVERIFY(!detail::fastRoundedScaled(1.5, 4, scaled));
}

void TestCommon::groupedTextMatchesDecimalDigits() {
    const std::vector<double> values = hardValues();
    for (size_t i = 0; i < values.size(); i += 3) {
        const double value = values[i];
        QCOMPARE(FormatMoney(value), groupedFromDigits(value, 2, false));
        QCOMPARE(FormatQuantity(value), groupedFromDigits(value, 3, false));
        QCOMPARE(FormatWhole(value), groupedFromDigits(value, 0, true));
        char buf[kNumberTextMax];
        const size_t len = FormatMoneyTo(buf, value);
        QCOMPARE(QString::fromLatin1(buf, static_cast<qsizetype>(len)), FormatMoney(value));
    }
    QCOMPARE(FormatGrouped(-1234.56789, 5), QStringLiteral("-1,234.56789"));
    // 301 integer digits with 100 commas, the sign, the point and two decimals
    QCOMPARE(FormatGrouped(-1.5e300, 2).size(), 301 + 100 + 1 + 1 + 2);
}

void TestCommon::plainWholeMatchesPlainNumber() {
    std::mt19937_64 random(7);
    std::uniform_int_distribution<long long> whole(-999999999999999LL, 999999999999999LL);
    char buf[kNumberTextMax];
    for (int i = 0; i < 100000; ++i) {
        const double value = static_cast<double>(whole(random) >> (i % 50));
        const size_t len = PlainWholeTo(buf, value);
        QVERIFY(len > 0);
        QCOMPARE(QString::fromLatin1(buf, static_cast<qsizetype>(len)), PlainNumber(value));
    }
    QCOMPARE(PlainWholeTo(buf, -0.0), size_t{1});
    QCOMPARE(buf[0], '0');
    QCOMPARE(PlainWholeTo(buf, 1e15), size_t{0}); // left to PlainNumber
    QCOMPARE(PlainWholeTo(buf, 0.5), size_t{0});
    QCOMPARE(FormatIntegerTo(buf, std::numeric_limits<long long>::min()), size_t{20});
    QCOMPARE(QByteArray(buf, 20), QByteArray("-9223372036854775808"));
}

void TestCommon::quickDatesMatchCalendar() {
    // The years the quick path takes, against Qt's calendar: every day of
    // 1900 to 2100 and every third day of the rest (3 is prime to the
    // lengths of weeks, months and years, so every day of the month occurs).
    const qint64 first = QDate(1000, 1, 1).toJulianDay();
    const qint64 last = QDate(9999, 12, 31).toJulianDay();
    const qint64 everyDayFrom = QDate(1900, 1, 1).toJulianDay();
    const qint64 everyDayTo = QDate(2100, 12, 31).toJulianDay();
    char buf[kNumberTextMax];
    for (qint64 jd = first; jd <= last; jd += jd >= everyDayFrom && jd <= everyDayTo ? 1 : 3) {
        const QDate date = QDate::fromJulianDay(jd);
        int y = 0;
        int m = 0;
        int d = 0;
        date.getDate(&y, &m, &d);
        const QByteArray expected = QByteArray::number(100 + d).mid(1) + '/' +
                                    QByteArray::number(100 + m).mid(1) + '/' +
                                    QByteArray::number(100 + y % 100).mid(1);
        const size_t len = FormatShortDateTo(buf, date);
        if (QByteArray(buf, static_cast<qsizetype>(len)) != expected)
            QFAIL(qPrintable(date.toString(Qt::ISODate)));
    }
    QCOMPARE(FormatShortDateTo(buf, QDate(999, 12, 31)), size_t{0});
    QCOMPARE(FormatShortDateTo(buf, QDate()), size_t{0});
    QCOMPARE(FormatLongDate(QDate(1600, 2, 29)), QStringLiteral("29/02/1600"));
    QCOMPARE(FormatShortDate(QDate(999, 12, 31)), QDate(999, 12, 31).toString(u"dd/MM/yy"));
}

namespace {
// windows-1255 of `text` by ICU alone, in one conversion, with the writer's
// handling of characters the code page cannot hold.
QByteArray icuBytes(const QString& text, TextFileWriter::Unmappable mode) {
    UErrorCode status = U_ZERO_ERROR;
    UConverter* conv = ucnv_open("windows-1255", &status);
    if (mode == TextFileWriter::Unmappable::CharacterReference) {
        ucnv_setFromUCallBack(conv, UCNV_FROM_U_CALLBACK_ESCAPE, UCNV_ESCAPE_XML_DEC, nullptr,
                              nullptr, &status);
    } else {
        ucnv_setSubstChars(conv, "?", 1, &status);
        ucnv_setFromUCallBack(conv, UCNV_FROM_U_CALLBACK_SUBSTITUTE, nullptr, nullptr, nullptr,
                              &status);
    }
    QByteArray out(static_cast<qsizetype>(text.size()) * 12 + 16, '\0');
    const int32_t n = ucnv_fromUChars(conv, out.data(), static_cast<int32_t>(out.size()),
                                      reinterpret_cast<const UChar*>(text.utf16()),
                                      static_cast<int32_t>(text.size()), &status);
    ucnv_close(conv);
    if (U_FAILURE(status))
        return QByteArray("ICU failed");
    out.truncate(n);
    return out;
}

QByteArray writtenInPieces(const QString& text, TextFileWriter::Unmappable mode,
                           const std::vector<qsizetype>& cuts) {
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("out.txt"));
    {
        TextFileWriter w(path, mode);
        qsizetype from = 0;
        for (const qsizetype cut : cuts) {
            w.write(QStringView(text).sliced(from, cut - from));
            from = cut;
        }
        w.write(QStringView(text).sliced(from));
        w.close();
    }
    return readAll(path);
}
} // namespace

void TestCommon::writerMatchesIcuForEveryUnit_data() {
    QTest::addColumn<int>("mode");
    QTest::newRow("page") << int(TextFileWriter::Unmappable::CharacterReference);
    QTest::newRow("csv") << int(TextFileWriter::Unmappable::QuestionMark);
}

void TestCommon::writerMatchesIcuForEveryUnit() {
    QFETCH(int, mode);
    const auto unmappable = static_cast<TextFileWriter::Unmappable>(mode);
    // Every BMP character but the surrogates, each once and each after a
    // Hebrew letter, in pieces of odd sizes: past the buffer too.
    QString text;
    for (char32_t c = 1; c < 0x10000; ++c) {
        if (c >= 0xD800 && c <= 0xDFFF)
            continue;
        text += QChar(static_cast<char16_t>(c));
        text += QChar(u'\u05D0');
    }
    std::vector<qsizetype> cuts;
    for (qsizetype at = 7; at < text.size(); at += 1 + (at * 31) % 997)
        cuts.push_back(at);
    QCOMPARE(writtenInPieces(text, unmappable, cuts), icuBytes(text, unmappable));
}

void TestCommon::writerSurrogatesAcrossPieces() {
    const QString emoji = QString::fromUcs4(U"\U0001F600");
    const QChar lead = emoji[0];
    const QChar trail = emoji[1];
    const QString texts[] = {
        QStringLiteral("a") + emoji + QStringLiteral("b"),
        QStringLiteral("a") + lead + QStringLiteral("b"),  // a lone high surrogate
        QStringLiteral("a") + trail + QStringLiteral("b"), // a lone low surrogate
        QStringLiteral("a") + lead + lead + trail,         // lone, then a pair
        QStringLiteral("a") + lead,                        // lone at the very end
        emoji + emoji + QChar(0x0635) + emoji + lead + QChar(0x0635),
    };
    for (const QString& text : texts) {
        for (int m = 0; m < 2; ++m) {
            const auto mode = static_cast<TextFileWriter::Unmappable>(m);
            for (qsizetype cut = 0; cut <= text.size(); ++cut)
                QCOMPARE(writtenInPieces(text, mode, {cut}), icuBytes(text, mode));
        }
    }
    // A held half followed by ASCII bytes is a lone half, as ICU sees it.
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("out.txt"));
    TextFileWriter w(path, TextFileWriter::Unmappable::CharacterReference);
    w.write(QString(lead));
    w.writeAscii("x");
    w.close();
    QCOMPARE(readAll(path),
             icuBytes(QString(lead) + u'x', TextFileWriter::Unmappable::CharacterReference));
}

void TestCommon::writerRewriteMatchesHtmlEscape() {
    static constexpr TextFileWriter::Rewrite kEntities{
        (std::uint64_t{1} << '&') | (std::uint64_t{1} << '<') | (std::uint64_t{1} << '>') |
            (std::uint64_t{1} << '"') | (std::uint64_t{1} << '\''),
        [](char16_t c) -> std::string_view {
            switch (c) {
            case u'&':
                return "&amp;";
            case u'<':
                return "&lt;";
            case u'>':
                return "&gt;";
            case u'"':
                return "&quot;";
            default:
                return "&#39;";
            }
        }};
    std::mt19937 random(3);
    const char16_t alphabet[] = u"ab <>&\"'\u05D0\u05EA\u0635\u20AA,.";
    QString text;
    for (int i = 0; i < 300000; ++i)
        text += QChar(alphabet[random() % (std::size(alphabet) - 1)]);
    QTemporaryDir dir;
    const QString rewritten = dir.filePath(QStringLiteral("rewritten.htm"));
    const QString escaped = dir.filePath(QStringLiteral("escaped.htm"));
    {
        TextFileWriter w(rewritten, TextFileWriter::Unmappable::CharacterReference);
        for (qsizetype at = 0; at < text.size(); at += 1000)
            w.write(QStringView(text).sliced(at, std::min<qsizetype>(1000, text.size() - at)),
                    kEntities);
        w.close();
        TextFileWriter plain(escaped, TextFileWriter::Unmappable::CharacterReference);
        plain.write(HtmlEscape(text));
        plain.close();
    }
    QCOMPARE(readAll(rewritten), readAll(escaped));

    TextFileWriter ascii(rewritten, TextFileWriter::Unmappable::CharacterReference);
    ascii.writeAscii("a<b>&'\"c", kEntities);
    ascii.close();
    QCOMPARE(readAll(rewritten), QByteArray("a&lt;b&gt;&amp;&#39;&quot;c"));
}

void TestCommon::writerAsciiAndClosed() {
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("out.csv"));
    TextFileWriter w(path, TextFileWriter::Unmappable::QuestionMark);
    const std::string line(3000, 'x');
    for (int i = 0; i < 1000; ++i) { // three megabytes: past the buffer
        w.writeAscii(line);
        w.endLine();
    }
    w.close();
    QCOMPARE(readAll(path).size(), qsizetype{3002 * 1000});
    QVERIFY_THROWS_EXCEPTION(Failure, w.writeAscii("x"));
    QVERIFY_THROWS_EXCEPTION(Failure, w.writeAscii(""));
    QVERIFY_THROWS_EXCEPTION(Failure, w.write(u"x"));
}

void TestCommon::plainMoneyIsMoneyWithoutCommas_data() {
    QTest::addColumn<double>("value");
    QTest::addColumn<QString>("expected");
    QTest::newRow("grouped") << 1234567.891 << QStringLiteral("1234567.89");
    QTest::newRow("negative") << -1234.5 << QStringLiteral("-1234.50");
    QTest::newRow("negative rounds to zero") << -0.004 << QStringLiteral("0.00");
    QTest::newRow("half cent up") << 1.005 << QStringLiteral("1.01");
    QTest::newRow("negative half cent") << -2.345 << QStringLiteral("-2.35");
    QTest::newRow("below a cent") << 0.05 << QStringLiteral("0.05");
    QTest::newRow("beyond the fast range") << 1e15 << QStringLiteral("1000000000000000.00");
    QTest::newRow("edge of the fast range")
        << 9999999999999.99 << QStringLiteral("9999999999999.99");
}

void TestCommon::plainMoneyIsMoneyWithoutCommas() {
    QFETCH(double, value);
    QFETCH(QString, expected);
    char buf[kNumberTextMax];
    const size_t len = FormatMoneyPlainTo(buf, value);
    QCOMPARE(QString::fromLatin1(buf, static_cast<qsizetype>(len)), expected);
}

void TestCommon::plainMoneyMatchesGroupedText() {
    // Every hard value, and the cents of random amounts of every size.
    std::vector<double> values = hardValues();
    std::mt19937_64 random(11);
    std::uniform_int_distribution<long long> cents(-99999999999LL, 99999999999LL);
    for (int i = 0; i < 200000; ++i)
        values.push_back(static_cast<double>(cents(random) >> (i % 40)) / 100.0 * 3.7);
    char buf[kNumberTextMax];
    for (const double value : values) {
        const size_t len = FormatMoneyPlainTo(buf, value);
        QString grouped = groupedFromDigits(value, 2, false);
        grouped.remove(u',');
        if (QString::fromLatin1(buf, static_cast<qsizetype>(len)) != grouped)
            QFAIL(qPrintable(QString::number(value, 'g', 17)));
    }
}

namespace {
// The writer's text with the rewrite done by hand: each character of `from`
// becomes `to` (which may be empty).
QString rewrittenByHand(const QString& text, const QString& from, const QString& to) {
    QString out;
    for (const QChar c : text)
        out += from.contains(c) ? to : QString(c);
    return out;
}
} // namespace

void TestCommon::writerBlocksMatchIcuForEveryUnit_data() {
    QTest::addColumn<int>("mode");
    QTest::addColumn<QString>("rewritten");
    QTest::addColumn<QString>("replacement");
    QTest::newRow("page, none") << int(TextFileWriter::Unmappable::CharacterReference) << QString()
                                << QString();
    QTest::newRow("csv, separators dropped")
        << int(TextFileWriter::Unmappable::QuestionMark) << QStringLiteral("\",'") << QString();
    // More characters than the encoder lists one by one.
    QTest::newRow("page, digits and space") << int(TextFileWriter::Unmappable::CharacterReference)
                                            << QStringLiteral("0123456789 ") << QStringLiteral("#");
}

void TestCommon::writerBlocksMatchIcuForEveryUnit() {
    QFETCH(int, mode);
    QFETCH(QString, rewritten);
    QFETCH(QString, replacement);
    const auto unmappable = static_cast<TextFileWriter::Unmappable>(mode);
    static QByteArray toBytes; // the replacement function has no state of its own
    toBytes = replacement.toLatin1();
    std::uint64_t bits = 0;
    for (const QChar c : rewritten)
        bits |= std::uint64_t{1} << c.unicode();
    const TextFileWriter::Rewrite rewrite(bits, [](char16_t) {
        return std::string_view(toBytes.constData(), static_cast<size_t>(toBytes.size()));
    });
    // Every BMP character but the surrogates inside runs of plain text (ASCII
    // and letters) of lengths 1 to 24, at every place of a run: each lands
    // in every lane of a block, at the end of a piece and in a repeated last
    // block. Pieces of odd sizes start at odd places.
    const QString plain = QStringLiteral("ab\u05D0c 9\u05EA-z\u05D3x/y\u05E9.Q7\u05D5~ m&<");
    QString text;
    int n = 0;
    for (char32_t c = 1; c < 0x10000; ++c) {
        if (c >= 0xD800 && c <= 0xDFFF)
            continue;
        const int run = 1 + n % 24;
        QString piece = plain.left(run);
        piece.insert((n / 24) % (run + 1), QChar(static_cast<char16_t>(c)));
        text += piece;
        ++n;
    }
    std::vector<qsizetype> cuts;
    for (qsizetype at = 5; at < text.size(); at += 1 + (at * 37) % 61)
        cuts.push_back(at);
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("out.txt"));
    {
        TextFileWriter w(path, unmappable);
        qsizetype from = 0;
        for (const qsizetype cut : cuts) {
            w.write(QStringView(text).sliced(from, cut - from), rewrite);
            from = cut;
        }
        w.write(QStringView(text).sliced(from), rewrite);
        w.close();
    }
    const QByteArray expected = icuBytes(rewrittenByHand(text, rewritten, replacement), unmappable);
    const QByteArray actual = readAll(path);
    QCOMPARE(actual.size(), expected.size());
    QVERIFY(actual == expected);
}

void TestCommon::writerAsciiPiecesOfEverySize() {
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("out.txt"));
    std::string all;
    {
        TextFileWriter w(path, TextFileWriter::Unmappable::QuestionMark);
        for (int size = 0; size <= 40; ++size) {
            for (int i = 0; i < 3; ++i) {
                std::string piece(static_cast<size_t>(size), 'a');
                for (int k = 0; k < size; ++k)
                    piece[static_cast<size_t>(k)] =
                        static_cast<char>('!' + (k * 7 + size + i) % 90);
                w.writeAscii(piece);
                all += piece;
            }
        }
        w.close();
    }
    QCOMPARE(readAll(path), QByteArray::fromStdString(all));
}

QTEST_GUILESS_MAIN(TestCommon)
void TestCommon::writerShortPiecesMatchGeneralPath_data() {
    QTest::addColumn<int>("mode");
    QTest::addColumn<QString>("rewritten");
    QTest::addColumn<QString>("replacement");
    QTest::newRow("page, none") << int(TextFileWriter::Unmappable::CharacterReference) << QString()
                                << QString();
    QTest::newRow("csv, separators dropped")
        << int(TextFileWriter::Unmappable::QuestionMark) << QStringLiteral("\",'") << QString();
    QTest::newRow("page, markup") << int(TextFileWriter::Unmappable::CharacterReference)
                                  << QStringLiteral("&<>\"'") << QStringLiteral("&#12345;");
    QTest::newRow("page, digits and space") << int(TextFileWriter::Unmappable::CharacterReference)
                                            << QStringLiteral("0123456789 ") << QStringLiteral("#");
}

// Pieces of 0 to 20 units (either side of the short-piece limit), drawn from
// plain text, rewritten characters, the letters' neighbours, characters the
// code page holds elsewhere or not at all, and surrogate halves, written
// once by write() and once by the general path alone: the same bytes.
void TestCommon::writerShortPiecesMatchGeneralPath() {
    QFETCH(int, mode);
    QFETCH(QString, rewritten);
    QFETCH(QString, replacement);
    const auto unmappable = static_cast<TextFileWriter::Unmappable>(mode);
    static QByteArray toBytes; // the replacement function has no state of its own
    toBytes = replacement.toLatin1();
    std::uint64_t bits = 0;
    for (const QChar c : rewritten)
        bits |= std::uint64_t{1} << c.unicode();
    const TextFileWriter::Rewrite rewrite(bits, [](char16_t) {
        return std::string_view(toBytes.constData(), static_cast<size_t>(toBytes.size()));
    });
    const char16_t alphabet[] = {u'a',   u'Z',   u'0',   u'9',   u' ',   u'~',   0x7F,   u'"',
                                 u'\'',  u',',   u'&',   u'<',   u'>',   u'#',   0x05D0, 0x05D1,
                                 0x05E9, 0x05EA, 0x05CF, 0x05EB, 0x05B0, 0x20AA, 0x00E9, 0x0635,
                                 0x0080, 0xD83D, 0xDE00, 0xFFFD, 0x0000};
    const auto letters = std::size(alphabet);
    std::mt19937 random(17);
    QTemporaryDir dir;
    const QString fast = dir.filePath(QStringLiteral("fast.txt"));
    const QString general = dir.filePath(QStringLiteral("general.txt"));
    {
        TextFileWriter a(fast, unmappable);
        TextFileWriter b(general, unmappable);
        for (int i = 0; i < 200000; ++i) {
            QString piece;
            const auto length = random() % 29;
            // Most pieces plain, so that the short path takes many of them.
            const bool plainOnly = random() % 3 != 0;
            for (unsigned k = 0; k < length; ++k) {
                const auto pick = random() % (plainOnly ? 16 : letters);
                piece += QChar(alphabet[pick]);
            }
            a.write(piece, rewrite);
            b.writeGeneral(piece, rewrite);
        }
        // Every character at every place of a plain piece of every short
        // length: the overlapping blocks see it once or twice.
        for (int length = 1; length <= 25; ++length) {
            for (int at = 0; at < length; ++at) {
                for (const char16_t c : alphabet) {
                    QString piece;
                    for (int k = 0; k < length; ++k)
                        piece += QChar(k == at ? c : alphabet[k % 2 == 0 ? 0 : 16]);
                    a.write(piece, rewrite);
                    b.writeGeneral(piece, rewrite);
                }
            }
        }
        a.close();
        b.close();
    }
    const QByteArray written = readAll(fast);
    QVERIFY(written.size() > 1000000); // past the buffer
    QCOMPARE(written, readAll(general));
}

// Every digit count from 1 to 20, at both ends of each and in between, and
// random values, against the standard library's own decimal text.
void TestCommon::integerTextAtEveryLength() {
    std::vector<unsigned long long> values = {0, 1, 9,
                                              std::numeric_limits<unsigned long long>::max()};
    unsigned long long power = 1;
    for (int k = 1; k <= 19; ++k) {
        power *= 10;
        values.insert(values.end(), {power - 1, power, power + 1, power / 2, power * 9 / 10 + 7});
    }
    std::mt19937_64 random(29);
    for (int i = 0; i < 100000; ++i)
        values.push_back(random() >> (random() % 64));
    char buf[kNumberTextMax];
    for (const unsigned long long value : values) {
        const std::string expected = std::to_string(value);
        QCOMPARE(std::string(buf, FormatUnsignedTo(buf, value)), expected);
        const auto signedValue = static_cast<long long>(value);
        QCOMPARE(std::string(buf, FormatIntegerTo(buf, signedValue)), std::to_string(signedValue));
    }
}

#include "test_common.moc"
