#include "reports/csv_writer.h"

#include "common/formats.h"
#include "common/module_state.h"
#include "common/text_file_writer.h"
#include "ledger/ledger_model.h"
#include "reports/page_markup.h"

#include <memory>

namespace ardcard::reports {

namespace {
// Grid columns 0 to 12 are exported; the grid's last four stay on screen.
constexpr int kLastExportedColumn = LedgerModel::kColumns - 5;

// A cell as the grid shows it, but for an amount's thousands commas: a
// number or date holds no separator a field may not carry, a text is
// stripped of them.
void writeCell(TextFileWriter& file, const LedgerModel::CellView& cell) {
    if (cell.isAscii)
        file.writeAscii(cell.ascii);
    else
        WriteStripped(file, cell.text);
}
} // namespace

void WriteCsv(const QString& path, const LedgerModel& ledger, const ModuleState& state,
              bool withCounterName) {
    const bool severalCompanies = state.CompanyDirCount > 1;
    TextFileWriter file(path, TextFileWriter::Unmappable::QuestionMark);

    file.write(u"שורה,תאריך,מנה,תנועה,תאריך ערך,אסמכתא 1,אסמכתא 2,פרטים,סכום,סכום מטח,מטבע,"
               u"יתרה שח,תמחיר,נגדי");
    if (withCounterName)
        file.write(u",שם נגדי");
    if (severalCompanies)
        file.write(u",חברה");
    file.endLine();

    const int lastDataRow = ledger.gridRowCount() - 2;
    // A scratch of some kilobytes, kept off the stack.
    const auto cells = std::make_unique<LedgerModel::RowCells>();
    for (int r = 1; r <= lastDataRow; ++r) {
        ledger.readRow(r, kLastExportedColumn, LedgerModel::MoneyText::Plain, *cells);
        for (int c = 0; c <= kLastExportedColumn; ++c) {
            writeCell(file, cells->cell[c]);
            file.writeAscii(",");
        }
        const RowDetail& detail = ledger.rowDetail(r);
        WriteStripped(file, detail.CounterKey);
        if (withCounterName) {
            file.writeAscii(",");
            WriteStripped(file, detail.CounterName);
        }
        if (severalCompanies) {
            file.writeAscii(",");
            WriteStripped(file, companyDir(state, detail.CompIndex));
        }
        file.endLine();
    }
    file.close();
}

void WriteCsvPage(const QString& path, const QString& csvPath) {
    TextFileWriter file(path, TextFileWriter::Unmappable::CharacterReference);
    file.writeLine(u"<HTML>");
    file.writeLine(u"<HEAD>");
    file.writeLine(kTitleLine);
    // The page shows Hebrew, so it names its code page like the statement.
    file.writeLine(kCharsetLine);
    file.writeLine(u"</HEAD>");
    file.writeLine(u"<BODY BGCOLOR='#FFFFFF' TEXT='#000000' LINK='#0000FF' VLINK='#800080'>");
    file.writeLine(u"<P Align='center'>");
    file.write(u"<A HREF='");
    WriteEscaped(file, csvPath);
    file.write(u"' WIDTH='100%' HEIGHT='100%'>");
    file.writeLine(u"<font face='Arial' size='+2' color='Blue'>");
    file.write(u"תקתק כאן לקבלת קובץ אקסל");
    file.writeLine(u"</font></A></P>");
    file.writeLine(u"<BR><BR>");
    file.writeLine(u"<P Align='right'>");
    file.writeLine(u"<font face='Arial' size='+1' color='Black'>");
    file.write(u":הסבר");
    file.writeLine(u"<BR><BR>");
    file.write(u":לאחר התקתוק, תתקבל הודעה המאפשרת לך לבחור מבין שתי אפשרויות");
    file.writeLine(u"<BR><BR>");
    file.write(u"לפתוח את הקובץ ישירות באמצעות אקסל");
    file.writeLine(u"<BR>");
    file.write(u"או");
    file.writeLine(u"<BR>");
    file.write(u"לשמור את הקובץ במיקום לפי בחירתך");
    file.writeLine(u"<BR>");
    file.writeLine(u"</font></P>");
    file.writeLine(u"</BODY>");
    file.writeLine(u"</HTML>");
    file.close();
}

} // namespace ardcard::reports
