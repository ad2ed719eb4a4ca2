#include "reports/statement_writer.h"

#include "common/formats.h"
#include "common/module_state.h"
#include "common/text_file_writer.h"
#include "ledger/ledger_model.h"
#include "reports/page_markup.h"

#include <QDate>
#include <memory>

namespace ardcard::reports {

namespace {

constexpr char16_t kRuleThick[] = u"  <tr><td colspan='14'><hr noshade size='2'></td></tr>";
constexpr char16_t kRuleThin[] = u"  <tr><td colspan='14'><hr noshade size='1'></td></tr>";
constexpr char16_t kRowOpen[] = u"  <tr bgcolor='#FFFFFF' align='right'>";
constexpr char16_t kInnerTable[] =
    u"<table width='100%' border='0' cellpadding='1' cellspacing='1'>";

// Grid columns 12 down to 0; the grid's last four columns stay on screen.
constexpr int kLastPrintedColumn = LedgerModel::kColumns - 5;

void writeHead(TextFileWriter& file) {
    file.writeLine(u"<HTML>");
    file.writeLine(u"<HEAD>");
    file.writeLine(kTitleLine);
    file.writeLine(kCharsetLine);
    file.writeLine(u"<style>.MyClass1{font-size : 10pt; color: blue;}");
    file.writeLine(u"       .Title1 {font-size : 12pt; color: blue; font-weight : bold;}");
    file.writeLine(u"       TD {font-size : 10pt; color: black;}");
    file.writeLine(u"</style>");
    file.writeLine(u"</HEAD>");
    file.writeLine(u"<BODY class=MyClass1 BGCOLOR='#FFFFFF' TEXT='#000000' LINK='#0000FF' "
                   u"VLINK='#800080'>");
    file.write(u"<p align='left'>");
    file.write(FormatLongDate(QDate::currentDate()));
    file.writeLine(u"</p>");
}

void writeHeadingBlock(TextFileWriter& file, const ModuleState& state, const ReportScreen& screen) {
    file.writeLine(kInnerTable);
    file.writeLine(u" <tr align=right><td width='40%'>");
    file.writeLine(kInnerTable);
    if (screen.showHeadDetails) {
        WriteStatementHeading(file, QStringLiteral(":יתרת הנהח"), screen.balance);
        WriteStatementHeading(file, QStringLiteral(":יתרת משלוח"), screen.shipBalance);
        WriteStatementHeading(file, QStringLiteral(":אובליגו"), screen.oblig);
    }
    file.writeLine(u"</table>");
    file.writeLine(u" </td>");
    file.writeLine(u" <td width='60%'>");
    file.writeLine(kInnerTable);
    WriteStatementHeading(file, QStringLiteral(":שם החברה"),
                          TrimSpaces(state.company.ShortName).toString());
    WriteStatementHeading(file, QStringLiteral(":מפתח החשבון"), screen.accountKey);
    WriteStatementHeading(file, QStringLiteral(":שם החשבון"), screen.accountName);
    if (screen.showHeadDetails) {
        WriteStatementHeading(file, QStringLiteral(":כתובת"), screen.address);
        WriteStatementHeading(file, QStringLiteral(":טלפון"), screen.telephone);
        WriteStatementHeading(file, QStringLiteral(":פרטים"), screen.details);
    }
    file.writeLine(u"</table>");
    file.writeLine(u" </td></tr>");
    file.writeLine(u"</table>");
}

void writeColumnHeadings(TextFileWriter& file) {
    file.writeLine(kInnerTable);
    file.writeLine(kRuleThick);
    file.writeLine(u"  <tr bgcolor='white' align='right'>");
    // The grid's order reversed, so that a right-to-left reader meets the
    // first column at the right.
    static constexpr const char16_t* kHeadings[] = {
        u"תמחיר", u"יתרה שח",   u"מטבע",  u"סכום מטח", u"סכום",  u"פרטים", u"אסמ 2",
        u"אסמ 1", u"תאריך ערך", u"תנועה", u"מנה",      u"תאריך", u"שורה",
    };
    for (const char16_t* heading : kHeadings) {
        file.write(u"    <td>");
        file.write(heading);
        file.writeLine(u"</td>");
    }
    file.writeLine(u"  </tr>");
    file.writeLine(kRuleThick);
}

void writeCompanySeparator(TextFileWriter& file, const QString& companyDirectory) {
    file.writeLine(kRuleThin);
    file.writeLine(kRowOpen);
    file.write(u"    <td colspan='14'><b>");
    WriteEscaped(file, companyDirectory);
    file.writeLine(u"</b></td>");
    file.writeLine(u"  </tr>");
    file.writeLine(kRuleThin);
}

// A cell's text escaped for the page; a formatted number or date has
// nothing to escape.
void writeCell(TextFileWriter& file, const LedgerModel::CellView& cell) {
    if (cell.isAscii)
        file.writeAscii(cell.ascii);
    else
        WriteEscaped(file, cell.text);
}

void writeRows(TextFileWriter& file, const LedgerModel& ledger, const ModuleState& state) {
    // The row markup is ASCII, written as bytes with its line ends: these
    // lines are most of a large statement.
    static constexpr std::string_view kRowOpenLine = "  <tr bgcolor='#FFFFFF' align='right'>\r\n";
    static constexpr std::string_view kCellOpen = "    <td>";
    static constexpr std::string_view kCellClose = "</td>\r\n";
    static constexpr std::string_view kRowClose = "  </tr>\r\n";

    const bool severalCompanies = state.CompanyDirCount > 1;
    int lastCompany = 0;
    const int lastDataRow = ledger.gridRowCount() - 2;
    // A scratch of some kilobytes, kept off the stack.
    const auto cells = std::make_unique<LedgerModel::RowCells>();
    for (int r = 1; r <= lastDataRow; ++r) {
        if (severalCompanies) {
            // Rows of one directory that are not consecutive (after a sort)
            // each get their own separator.
            const int company = ledger.rowDetail(r).CompIndex;
            if (company != lastCompany) {
                writeCompanySeparator(file, companyDir(state, company));
                lastCompany = company;
            }
        }
        file.writeAscii(kRowOpenLine);
        ledger.readRow(r, kLastPrintedColumn, LedgerModel::MoneyText::Grouped, *cells);
        for (int c = kLastPrintedColumn; c >= 0; --c) {
            file.writeAscii(kCellOpen);
            writeCell(file, cells->cell[c]);
            file.writeAscii(kCellClose);
        }
        file.writeAscii(kRowClose);
    }
}

void writeCurrencyTotals(TextFileWriter& file, const ModuleState& state) {
    for (int n = 1; n <= kCurrencyCount; ++n) {
        const double total = state.CurrencyTotals[n];
        if (total == 0.0)
            continue;
        file.writeLine(kRowOpen);
        file.writeLine(u"    <td colspan='2'></td>");
        file.write(u"    <td align='right'>");
        WriteEscaped(file, state.CurrencyCodes[n]);
        file.writeLine(u"</td>");
        file.write(u"    <td align='right'>");
        file.write(FormatMoney(total));
        file.writeLine(u"</td>");
        file.writeLine(u"    <td colspan='9'></td>");
        file.writeLine(u"  </tr>");
    }
}

} // namespace

void WriteStatementHeading(TextFileWriter& file, const QString& title, const QString& content) {
    if (content.isEmpty())
        return;
    file.writeLine(u"  <tr>");
    file.write(u"     <td width='70%' align='right'><b>");
    WriteEscaped(file, content);
    file.writeLine(u"</b></td>");
    file.write(u"     <td width='30%' align='right'><b>");
    WriteEscaped(file, title);
    file.writeLine(u"</b></td>");
    file.writeLine(u"  </tr>");
}

void WriteStatement(const QString& path, const LedgerModel& ledger, const ModuleState& state,
                    const ReportScreen& screen) {
    TextFileWriter file(path, TextFileWriter::Unmappable::CharacterReference);
    writeHead(file);
    writeHeadingBlock(file, state, screen);
    writeColumnHeadings(file);
    writeRows(file, ledger, state);
    file.writeLine(kRuleThick);
    writeCurrencyTotals(file, state);
    WritePageFooter(file);
    file.close();
}

} // namespace ardcard::reports
