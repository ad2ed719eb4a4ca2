#pragma once

#include <QString>
#include <QStringList>
#include <QVariant>
#include <functional>
#include <vector>

namespace ardcard {

class Recordset;
class TextFileWriter;

namespace info {

// The pieces every information page is made of. A page is written line by
// line through a TextFileWriter; a failure (a query, a write) throws Failure
// and the writer, owned by the page builder, closes the file on the way out.
//
// Text that comes from the database or from the caller's key is escaped
// before it enters a page (cell texts, captions, tool tips, the linked-file
// address), so notes holding markup are shown as text and cannot break an
// attribute; the fixed markup and the Hebrew texts are written as they stand.

// Creates the page file, lets `body` write it and closes it. When `body`
// fails, what it wrote so far is still put into the file before the failure
// goes on to the caller, so a half-built page holds every line written.
void WritePageFile(const QString& path, const std::function<void(TextFileWriter&)>& body);

// The key as an SQL string literal: quotes doubled, enclosed in single quotes,
// and for connection type 2 (a Unicode server) prefixed with N.
QString KeyLiteral(const QString& key, int connType);

// The ten rules of the page style sheet.
void WriteHtmlStyle(TextFileWriter& out);

// "<HTML>" to the opening "<BODY ...>" line: title line, code page, style
// sheet, then the script lines (if any) before the head ends.
void WritePageHead(TextFileWriter& out, const QString& titleLine,
                   const QStringList& scriptLines = {});

// The small page shown while the real page is built; a complete file.
void WriteWaitPage(const QString& path);

// The frame table that holds the title row and the layout rows, and its end
// (table, footer, body, document).
void WriteFrameOpening(TextFileWriter& out);
void WriteFrameClosing(TextFileWriter& out);

// Opening lines of the layout cells.
inline constexpr char16_t kLayoutRowFirstCell[] = u"<tr valign='top'><td width='50%' colspan=1>";
inline constexpr char16_t kLayoutSecondCell[] = u"<td width='50%' colspan=1>";

// Cell texts: "&nbsp;" for Null, otherwise the value's escaped text.
QString CellText(const QVariant& value);
// "#,##0.00", "#,##0.000" and "dd/mm/yyyy"; Null gives "&nbsp;".
QString MoneyText(const QVariant& value);
QString QuantityText(const QVariant& value);
QString DateText(const QVariant& value);

// A whole cell line: prefix, text, "</td>".
inline QString Cell(const QString& prefix, const QString& text) {
    return prefix + text + QStringLiteral("</td>");
}

// Heading lines of a list section, one per text.
QStringList HeadingLines(const QStringList& texts);
// One plain cell line per field of the current row.
void WritePlainCells(TextFileWriter& out, const Recordset& rs, const QStringList& fields,
                     const QString& prefix = QStringLiteral("    <td>"));
// The "default?" cell of an alternative key: "כן" when the flag is 1.
QString DefaultFlagCell(const QVariant& def);

// One section that lists the rows of one query as a table.
struct ListSection {
    QString opening; // the layout cell's opening line, written whatever is found
    QString sql;
    QString caption;      // whole caption line
    QStringList headings; // whole heading lines
    // Writes the cell lines of the current row.
    std::function<void(TextFileWriter&, const Recordset&)> writeCells;
    QString closing; // "</td>" or "</td></tr>", written only when rows were found
};

// Opens the section's query on `rs` with the connection string, writes the
// table when it finds rows, and closes `rs` again.
void WriteListSection(TextFileWriter& out, Recordset& rs, const QString& connStr,
                      const ListSection& section);

// One group of the details section: heading texts over value lines.
struct DetailsGroup {
    QStringList headings; // heading texts (fixed Hebrew)
    QStringList values;   // whole value lines (see the *Value helpers)
};

// Value lines of the details section.
QString DetailValue(const QString& text);
QString BoldValue(const QVariant& value);
QString LinkedFileValue(const QVariant& value);

// The details section, closed by "</td>".
void WriteDetailsSection(TextFileWriter& out, const std::vector<DetailsGroup>& groups);

// The queries of the extra-fields section. `noteIdField` and the like name
// the column holding the field's number, shown as a tool tip; empty on the
// account page, which writes no tool tips.
struct ExtraFieldQueries {
    QString notesSql;
    QString sumsSql;
    QString datesSql;
    QString noteIdField;
    QString sumIdField;
    QString dateIdField;
};

// The extra-fields cell (notes, sums, dates), closed by "</td></tr>".
void WriteExtraFieldsSection(TextFileWriter& out, Recordset& rs, const QString& connStr,
                             const ExtraFieldQueries& queries);

} // namespace info
} // namespace ardcard
