#include "reports/page_markup.h"

#include "common/text_file_writer.h"
#include "common/text_helpers.h"

#include <cstdint>

namespace ardcard::reports {

QString OutputPath(QStringView fileName) {
    QString path = TempDirectory();
    path += u'/';
    path += fileName;
    return path;
}

namespace {
// & < > " and ' are all below 64, so the writer finds them with one bit test
// per character while it encodes; most cells hold none.
std::string_view entityFor(char16_t c) {
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
}
constexpr TextFileWriter::Rewrite kEscapeMarkup{
    (std::uint64_t{1} << '&') | (std::uint64_t{1} << '<') | (std::uint64_t{1} << '>') |
        (std::uint64_t{1} << '"') | (std::uint64_t{1} << '\''),
    entityFor};

// A CSV field loses " ' and , (all below 64 as well).
constexpr TextFileWriter::Rewrite kStripSeparators{
    (std::uint64_t{1} << '"') | (std::uint64_t{1} << '\'') | (std::uint64_t{1} << ','),
    [](char16_t) { return std::string_view(); }};
} // namespace

void WriteEscaped(TextFileWriter& file, QStringView text) {
    file.write(text, kEscapeMarkup);
}

void WriteEscaped(TextFileWriter& file, std::string_view ascii) {
    file.writeAscii(ascii, kEscapeMarkup);
}

void WriteStripped(TextFileWriter& file, QStringView text) {
    file.write(text, kStripSeparators);
}

void WriteStripped(TextFileWriter& file, std::string_view ascii) {
    file.writeAscii(ascii, kStripSeparators);
}

QStringView TrimSpaces(QStringView text) {
    qsizetype begin = 0;
    qsizetype end = text.size();
    while (begin < end && text[begin] == u' ')
        ++begin;
    while (end > begin && text[end - 1] == u' ')
        --end;
    return text.sliced(begin, end - begin);
}

void WritePageFooter(TextFileWriter& file) {
    file.writeLine(u"</table>");
    file.writeLine(u"<hr size='2' width='100%'>");
    file.writeLine(u"<p align='center'>ולמור מערכות מידע</p>");
    file.writeLine(u"</BODY>");
    file.writeLine(u"</HTML>");
}

} // namespace ardcard::reports
