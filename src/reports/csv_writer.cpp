#include "reports/csv_writer.h"

#include "common/copy_bytes.h"

#include "common/formats.h"
#include "common/module_state.h"
#include "common/text_file_writer.h"
#include "ledger/ledger_model.h"
#include "reports/page_markup.h"

#include <cstring>
#include <memory>
#include <string_view>

namespace ardcard::reports {

namespace {
// Grid columns 0 to 12 are exported; the grid's last four stay on screen.
constexpr int kLastExportedColumn = LedgerModel::kColumns - 5;

// A row's numbers, dates and separators gathered between its texts, so that
// each stretch of them goes to the file in one write rather than a write per
// cell and per comma. The ASCII cells are numbers and dates read with plain
// amounts: they hold none of the characters a field may not carry and go to
// the file as they stand; only texts need the stripping pass.
class AsciiRun {
public:
    // Room for the longest text of every exported cell, their separators and
    // the line's end.
    static constexpr size_t kRoom = LedgerModel::kColumns * (kNumberTextMax + 1) + 2;

    void add(std::string_view ascii) {
        CopyBytes(end_, ascii.data(), ascii.size());
        end_ += ascii.size();
    }
    void add(char c) { *end_++ = c; }
    // Writes what was gathered and starts the next stretch.
    void writeTo(TextFileWriter& file) {
        file.writeAscii(std::string_view(held_, static_cast<size_t>(end_ - held_)));
        end_ = held_;
    }
    // A text field: the stretch before it goes first.
    void text(TextFileWriter& file, QStringView text) {
        writeTo(file);
        WriteStripped(file, text);
    }

private:
    char held_[kRoom];
    char* end_ = held_;
};

void addCell(AsciiRun& run, TextFileWriter& file, const LedgerModel::CellView& cell) {
    if (cell.isAscii)
        run.add(cell.ascii);
    else
        run.text(file, cell.text);
}

// The longest text of cells 0 to 6 on the typed way with their commas: an
// int, two dates, two 64-bit integers and two whole numbers below 1e15.
constexpr size_t kLeadRoom = 128;

// Cells 0 to 6 of a row and a comma after each, straight from the typed
// row; null when one of them needs the general conversion (a batch number
// held as text, a reference with a fraction, a date out of the quick
// range), which the cell-by-cell way writes instead. The typed texts are
// the grid's own (the same formatting functions), and none holds a comma.
char* leadCells(char* out, const LedgerRow& row, ShortDateMemo (&dates)[2]) {
    out += FormatIntegerTo(out, row.rowNumber);
    *out++ = ',';
    size_t n = FormatShortDateTo(out, row.valueDate, dates[0]);
    if (n == 0)
        return nullptr;
    out += n;
    *out++ = ',';
    if ((n = FormatStoredIntegerTo(out, row.batchNo)) == 0)
        return nullptr;
    out += n;
    *out++ = ',';
    if ((n = FormatStoredIntegerTo(out, row.transId)) == 0)
        return nullptr;
    out += n;
    *out++ = ',';
    if ((n = FormatShortDateTo(out, row.dueDate, dates[1])) == 0)
        return nullptr;
    out += n;
    *out++ = ',';
    if ((n = PlainWholeTo(out, row.referance)) == 0)
        return nullptr;
    out += n;
    *out++ = ',';
    if ((n = PlainWholeTo(out, row.ref2)) == 0)
        return nullptr;
    out += n;
    *out++ = ',';
    return out;
}

// An amount without thousands commas between `before` and `after`.
char* amountCell(char* out, char before, double amount, char after) {
    *out++ = before;
    out += FormatMoneyPlainTo(out, amount);
    *out++ = after;
    return out;
}

// Cells 0 to 12 of a row formatted straight into the file's buffer, the
// texts between them stripped; false, having written nothing, for a row
// that needs the general conversion somewhere.
bool writeTypedCells(TextFileWriter& file, const LedgerRow& row, ShortDateMemo (&dates)[2]) {
    char* const end = leadCells(file.asciiRoom(kLeadRoom), row, dates);
    if (!end)
        return false;
    file.commitAscii(end);
    WriteStripped(file, row.description);
    char* out = file.asciiRoom(2 * kNumberTextMax + 3);
    out = amountCell(out, ',', row.amount, ',');
    out += FormatMoneyPlainTo(out, row.foreignAmount);
    *out++ = ',';
    file.commitAscii(out);
    WriteStripped(file, row.currencyCode);
    file.commitAscii(amountCell(file.asciiRoom(kNumberTextMax + 2), ',', row.balance, ','));
    WriteStripped(file, row.costCode);
    return true;
}

// The company directory of a row as companyDir() gives it, without a copy
// of the text for every row.
QStringView companyDirView(const ModuleState& state, int index) {
    if (index < 0 || index >= state.CompanyDirList.size())
        return {};
    return state.CompanyDirList.at(index);
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
    // Scratches of some kilobytes, kept off the stack.
    const auto cells = std::make_unique<LedgerModel::RowCells>();
    const auto run = std::make_unique<AsciiRun>();
    ShortDateMemo dates[2];
    for (int r = 1; r <= lastDataRow; ++r) {
        // Most rows take the typed way; the rest go cell by cell through the
        // grid's general texts.
        if (!writeTypedCells(file, ledger.row(r), dates)) {
            ledger.readRow(r, kLastExportedColumn, LedgerModel::MoneyText::Plain, *cells);
            addCell(*run, file, cells->cell[0]);
            for (int c = 1; c <= kLastExportedColumn; ++c) {
                run->add(',');
                addCell(*run, file, cells->cell[c]);
            }
            run->writeTo(file);
        }
        const RowDetail& detail = ledger.rowDetail(r);
        file.writeAscii(",");
        WriteStripped(file, detail.CounterKey);
        if (withCounterName) {
            file.writeAscii(",");
            WriteStripped(file, detail.CounterName);
        }
        if (severalCompanies) {
            file.writeAscii(",");
            WriteStripped(file, companyDirView(state, detail.CompIndex));
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
