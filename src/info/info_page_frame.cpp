#include "info/info_page_frame.h"

#include "common/formats.h"
#include "common/html_escape.h"
#include "common/text_file_writer.h"
#include "common/text_helpers.h"
#include "connection/database.h"

namespace ardcard::info {

namespace {
const QString kNbsp = QStringLiteral("&nbsp;");

void writeLines(TextFileWriter& out, std::initializer_list<const char16_t*> lines) {
    for (const char16_t* line : lines)
        out.writeLine(QStringView(line));
}

double toDouble(const QVariant& value) {
    if (value.typeId() == QMetaType::QString)
        return value.toString().trimmed().toDouble();
    return value.toDouble();
}
} // namespace

void WritePageFile(const QString& path, const std::function<void(TextFileWriter&)>& body) {
    TextFileWriter out(path, TextFileWriter::Unmappable::CharacterReference);
    body(out); // on a failure the writer closes the file with what it holds
    out.close();
}

QString KeyLiteral(const QString& key, int connType) {
    QString doubled = key;
    doubled.replace(u'\'', QStringLiteral("''"));
    const QString literal = u'\'' + doubled + u'\'';
    return connType == 2 ? u'N' + literal : literal;
}

void WriteHtmlStyle(TextFileWriter& out) {
    writeLines(
        out,
        {
            u"  BODY {direction:rtl; background:#FFFFFF ;margin-top:10; margin-left:10; "
            u"margin-right:10; vertical-align:top;}",
            u"  TABLE {border: thin solid #ADD6EA; padding: 2 2 2 2; border-spacing: 2; "
            u"border-collapse: separate}",
            u"  TD {font-size : 9pt; color: black; font-family: arial; text-align: right}",
            u"  A {font-size : 9pt; color: blue; font-family: arial;}",
            u"  .TblClean {border: none}",
            u"  .Cap {background:#5F8EBE; font-size : 9pt; color: white; font-family: Arial; "
            u"font-weight: bold}",
            u"  .GCap {font-size : 9pt; color: #5F8EBE; font-family: Arial; font-weight: bold}",
            u"  .Title1 {font-size : 10pt; color: #5F8EBE; font-family: arial; font-weight : "
            u"bold;}",
            u"  .Velmor {font-size : 8pt; color: black; font-family: arial;}",
            u"  .VLBut {background:#6699CC ;CURSOR: hand; COLOR: white}",
        });
}

void WritePageHead(TextFileWriter& out, const QString& titleLine, const QStringList& scriptLines) {
    writeLines(out, {u"<HTML>", u"<HEAD>"});
    out.writeLine(titleLine);
    writeLines(out, {u"<meta http-equiv='Content-Type' content='text/html; charset=windows-1255'>",
                     u"<style>"});
    WriteHtmlStyle(out);
    out.writeLine(u"</style>");
    for (const QString& line : scriptLines)
        out.writeLine(line);
    writeLines(out, {u"</HEAD>", u"<BODY TEXT='#000000' LINK='#0000FF' VLINK='#800080'>"});
}

// The style lines are long: each is written as adjacent literals.
// NOLINTBEGIN(bugprone-suspicious-missing-comma)
void WriteWaitPage(const QString& path) {
    WritePageFile(path, [](TextFileWriter& out) {
        writeLines(
            out,
            {
                u"<HTML>",
                u"<HEAD>",
                u"<TITLE>ולמור מערכות מידע</TITLE>",
                u"<meta http-equiv='Content-Type' content='text/html; charset=windows-1255'>",
                u"<style>",
                u"  BODY {direction:rtl; background:#FFFFFF ;margin-top:10; margin-left:10; "
                u"margin-right:10; vertical-align:top;}",
                u"  TABLE {border: thin solid #5F8EBE; padding: 2 2 2 2; border-spacing: 2; "
                u"border-collapse: separate}",
                u"  TD {font-size : 9pt; color: black; font-family: arial; text-align: center}",
                u"  A {text-decoration: none}",
                u"  .TblClean {border: none}",
                u"  .Title1 {font-size : 12pt; color: #5F8EBE; font-family: arial; font-weight "
                u": bold;}",
                u"  .Velmor {font-size : 8pt; color: black; font-family: arial;}",
                u"</style>",
                u"</HEAD>",
                u"<BODY TEXT='#000000' LINK='#0000FF' VLINK='#800080'>",
                u"<table height='100%' width='100%' border='0' cellpadding='3' cellspacing='3'>",
                u"<tr width='100%' valign='middle'>",
                u"<td width='100%' class=Title1>אוסף נתונים. נא להמתין...</td>",
                u"</tr>",
                u"</table>",
                u"</BODY>",
                u"</HTML>",
            });
    });
}
// NOLINTEND(bugprone-suspicious-missing-comma)

void WriteFrameOpening(TextFileWriter& out) {
    out.writeLine(
        u"<table class=TblClean width='100%' border='0' cellpadding='3' cellspacing='3'>");
}

void WriteFrameClosing(TextFileWriter& out) {
    writeLines(out, {u"</table>", u"<p class=Velmor align='center'>ולמור מערכות מידע</p>",
                     u"</BODY>", u"</HTML>"});
}

QString CellText(const QVariant& value) {
    return value.isNull() ? kNbsp : HtmlEscape(ardcard::PlainText(value));
}

QString MoneyText(const QVariant& value) {
    return value.isNull() ? kNbsp : FormatMoney(toDouble(value));
}

QString QuantityText(const QVariant& value) {
    return value.isNull() ? kNbsp : FormatQuantity(toDouble(value));
}

QString DateText(const QVariant& value) {
    if (value.isNull())
        return kNbsp;
    const QDate date = ToDate(value);
    // A value that is no date at all is shown as it stands rather than lost.
    return date.isValid() ? FormatLongDate(date) : CellText(value);
}

QStringList HeadingLines(const QStringList& texts) {
    QStringList lines;
    for (const QString& text : texts)
        lines << QStringLiteral("   <td class=Cap>") + text + QStringLiteral("</td>");
    return lines;
}

void WritePlainCells(TextFileWriter& out, const Recordset& rs, const QStringList& fields,
                     const QString& prefix) {
    for (const QString& field : fields)
        out.writeLine(Cell(prefix, CellText(rs.field(field))));
}

QString DefaultFlagCell(const QVariant& def) {
    return !def.isNull() && def.toInt() == 1 ? QStringLiteral("    <td>כן</td>")
                                             : Cell(QStringLiteral("    <td>"), kNbsp);
}

void WriteListSection(TextFileWriter& out, Recordset& rs, const QString& connStr,
                      const ListSection& section) {
    out.writeLine(section.opening);
    rs.Open(section.sql, connStr);
    if (!(rs.Bof() && rs.Eof())) {
        out.writeLine(u" <table width='100%' border='0'>");
        out.writeLine(section.caption);
        out.writeLine(u"  <tr valign='middle' align='right'>");
        for (const QString& heading : section.headings)
            out.writeLine(heading);
        out.writeLine(u"  </tr>");
        while (!rs.Eof()) {
            out.writeLine(u"  <tr align='right'>");
            section.writeCells(out, rs);
            out.writeLine(u"  </tr>");
            rs.MoveNext();
        }
        out.writeLine(u" </table>");
        out.writeLine(section.closing);
    }
    rs.Close();
}

QString DetailValue(const QString& text) {
    return Cell(QStringLiteral("     <td>"), text);
}

QString BoldValue(const QVariant& value) {
    return QStringLiteral("     <td><b>") + CellText(value) + QStringLiteral("</b></td>");
}

QString LinkedFileValue(const QVariant& value) {
    if (value.isNull() || ardcard::PlainText(value).isEmpty())
        return DetailValue(kNbsp);
    return QStringLiteral("     <td><a href='") + CellText(value) +
           QStringLiteral("' target='_blank'>קליק לקובץ</a></td>");
}

void WriteDetailsSection(TextFileWriter& out, const std::vector<DetailsGroup>& groups) {
    out.writeLine(u" <table width='100%' border='0'>");
    for (const DetailsGroup& group : groups) {
        writeLines(out, {u"  <tr align='right'>", u"   <td>",
                         u"   <table class=TblClean width='100%' border='0'>",
                         u"    <tr align='right'>"});
        for (const QString& heading : group.headings)
            out.writeLine(Cell(QStringLiteral("     <td class=Cap>"), heading));
        writeLines(out, {u"    </tr>", u"    <tr align='right'>"});
        for (const QString& value : group.values)
            out.writeLine(value);
        writeLines(out, {u"    </tr>", u"    </table>", u"   </td>", u"  </tr>"});
    }
    writeLines(out, {u" </table>", u"</td>"});
}

namespace {
// One kind of extra field: its query, the columns of name, value and number,
// the row's opening line and how the value becomes text.
struct ExtraKind {
    const QString& sql;
    const char16_t* rowOpening;
    QString nameField;
    QString valueField;
    const QString& idField;
    QString (*valueText)(const QVariant&);
};

void writeExtraKind(TextFileWriter& out, Recordset& rs, const QString& connStr,
                    const ExtraKind& kind) {
    rs.Open(kind.sql, connStr);
    while (!rs.Eof()) {
        out.writeLine(QStringView(kind.rowOpening));
        const QString name = CellText(rs.field(kind.nameField));
        if (kind.idField.isEmpty())
            out.writeLine(QStringLiteral("    <td class=GCap>") + name + QStringLiteral(":</td>"));
        else
            out.writeLine(QStringLiteral("    <td title='") + CellText(rs.field(kind.idField)) +
                          QStringLiteral("' class=GCap>") + name + QStringLiteral(":</td>"));
        out.writeLine(Cell(QStringLiteral("    <td>"), kind.valueText(rs.field(kind.valueField))));
        out.writeLine(u"  </tr>");
        rs.MoveNext();
    }
    rs.Close();
}
} // namespace

void WriteExtraFieldsSection(TextFileWriter& out, Recordset& rs, const QString& connStr,
                             const ExtraFieldQueries& queries) {
    writeLines(out,
               {u"<td valign='top' width='50%' colspan=1>", u" <table width='100%' border='0'>",
                u" <tr><td width='100%' colspan=2 class=Cap align=right>תאריכים, סכומים "
                u"ונתונים נוספים</td></tr>"});
    writeExtraKind(out, rs, connStr,
                   {queries.notesSql, u"  <tr valign='top' align='right'>",
                    QStringLiteral("NoteName"), QStringLiteral("Note"), queries.noteIdField,
                    &CellText});
    writeExtraKind(out, rs, connStr,
                   {queries.sumsSql, u"  <tr align='right'>", QStringLiteral("SuFName"),
                    QStringLiteral("SuF"), queries.sumIdField, &CellText});
    writeExtraKind(out, rs, connStr,
                   {queries.datesSql, u"  <tr align='right'>", QStringLiteral("DatFName"),
                    QStringLiteral("DatF"), queries.dateIdField, &DateText});
    writeLines(out, {u" </table>", u"</td></tr>"});
}

} // namespace ardcard::info
