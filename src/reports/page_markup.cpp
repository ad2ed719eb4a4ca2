#include "reports/page_markup.h"

#include "common/html_escape.h"
#include "common/text_file_writer.h"
#include "common/text_helpers.h"

namespace ardcard::reports {

QString OutputPath(QStringView fileName) {
    QString path = TempDirectory();
    path += u'/';
    path += fileName;
    return path;
}

namespace {
// A CSV field loses " ' and , : the fields are never quoted, so none may
// carry the separator.
struct StrippedFromCsv {
    const char* operator()(char16_t c) const {
        return c == u'"' || c == u'\'' || c == u',' ? "" : nullptr;
    }
};
struct EscapedForPage {
    const char* operator()(char16_t c) const { return HtmlEntity(c); }
};

// Writes `text` with each character that `Replacement` names written as
// its replacement instead; the runs between them go to the file as they
// stand, so a cell costs no copy of its own.
template <typename Replacement> void writeReplacing(TextFileWriter& file, QStringView text) {
    const Replacement replacement;
    qsizetype from = 0;
    for (qsizetype i = 0; i < text.size(); ++i) {
        // Every character rewritten is ASCII below "@": one compare passes
        // over letters, Hebrew among them.
        const char16_t c = text[i].unicode();
        if (c >= u'@')
            continue;
        if (const char* with = replacement(c)) {
            file.write(text.sliced(from, i - from));
            file.writeAscii(with);
            from = i + 1;
        }
    }
    file.write(text.sliced(from));
}
} // namespace

void WriteEscaped(TextFileWriter& file, QStringView text) {
    writeReplacing<EscapedForPage>(file, text);
}

void WriteStripped(TextFileWriter& file, QStringView text) {
    writeReplacing<StrippedFromCsv>(file, text);
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
