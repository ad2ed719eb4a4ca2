#include "info/doc_types_page.h"

#include "common/text_file_writer.h"
#include "connection/database.h"
#include "info/info_page_frame.h"

namespace ardcard::info {

QString DocTypeCodeText(qint64 code) {
    const QString sign = code < 0 ? QStringLiteral("-") : QStringLiteral(" ");
    const quint64 magnitude =
        code < 0 ? 0 - static_cast<quint64>(code) : static_cast<quint64>(code);
    return sign + QString::number(magnitude) + u' ';
}

void WriteDocTypesPage(const QString& path, const QString& connStr) {
    WritePageFile(path, [&](TextFileWriter& out) {
        WritePageHead(out, QStringLiteral("<TITLE>סוגי מסמכים</TITLE>"));
        out.writeLine(u"<table class=TblClean border='0' cellpadding='3' cellspacing='3'>");
        out.writeLine(u"<tr><td class=Title1 align='right'>סוגי מסמכים - ארדקו חלונות</td></tr>");
        out.writeLine(u"</table>");

        Recordset rs;
        rs.Open(QStringLiteral("Select D.DocumentID, D.DocName"
                               " From DocumentsDef D"
                               " Where D.DocumentID > 0"),
                connStr);
        if (rs.Bof() && rs.Eof()) {
            rs.Close();
            return;
        }
        out.writeLine(u" <table width='50%' align='right' border='0'>");
        out.writeLine(u"  <tr align='right'>");
        out.writeLine(u"   <td class=Cap>קוד סוג מסמך</td>");
        out.writeLine(u"   <td class=Cap>שם סוג מסמך</td>");
        out.writeLine(u"  </tr>");
        while (!rs.Eof()) {
            out.writeLine(u"  <tr align='right'>");
            const QVariant code = rs.field(QStringLiteral("DocumentID"));
            out.writeLine(Cell(QStringLiteral("   <td>"),
                               code.isNull() ? QStringLiteral("&nbsp;")
                                             : DocTypeCodeText(code.toLongLong())));
            out.writeLine(
                Cell(QStringLiteral("   <td>"), CellText(rs.field(QStringLiteral("DocName")))));
            out.writeLine(u"  </tr>");
            rs.MoveNext();
        }
        rs.Close();
        out.writeLine(u"</table>");
        out.writeLine(u"</BODY>");
        out.writeLine(u"</HTML>");
    });
}

} // namespace ardcard::info
