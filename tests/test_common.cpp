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
    void writerMatchesIcuForEveryUnit_data();
    void writerMatchesIcuForEveryUnit();
    void writerSurrogatesAcrossPieces();
    void writerAsciiAndClosed();
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

namespace {} // namespace

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

QTEST_GUILESS_MAIN(TestCommon)
#include "test_common.moc"
