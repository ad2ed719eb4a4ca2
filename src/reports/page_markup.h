#pragma once

#include <QString>
#include <QStringView>
#include <string_view>

namespace ardcard {
class TextFileWriter;
}

namespace ardcard::reports {

// File names of the outputs in the temporary directory.
inline constexpr char16_t kStatementFile[] = u"vlprint.htm";
inline constexpr char16_t kCsvFile[] = u"vltrans1.csv";
inline constexpr char16_t kCsvPageFile[] = u"vltrans1.htm";
inline constexpr char16_t kGraphFile[] = u"vtransg.htm";

// Lines every output page shares.
inline constexpr char16_t kTitleLine[] = u"<TITLE>ולמור מערכות מידע מציגה</TITLE>";
inline constexpr char16_t kCharsetLine[] =
    u"<meta http-equiv='Content-Type' content='text/html; charset=windows-1255'>";

// The full path of an output file: the user's temporary directory (TMPDIR,
// else the platform's default) and the file name.
QString OutputPath(QStringView fileName);

// Writes text from the database, the screen or a path into a page so that
// it shows as text: & < > " ' become entities (HtmlEntity).
void WriteEscaped(TextFileWriter& file, QStringView text);

// Writes a CSV field without its double quotes, single quotes and commas,
// so that no field can carry the separator (the fields are never quoted).
void WriteStripped(TextFileWriter& file, QStringView text);

// The text without leading and trailing spaces (only the space character:
// a company name keeps a tab or a no-break space of its own).
QStringView TrimSpaces(QStringView text);

// The closing lines of the statement and the graph page, from "</table>" to
// "</HTML>".
void WritePageFooter(TextFileWriter& file);

} // namespace ardcard::reports
