#include "reports/page_markup.h"

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
QStringView entityFor(char16_t c) {
    switch (c) {
    case u'&':
        return u"&amp;";
    case u'<':
        return u"&lt;";
    case u'>':
        return u"&gt;";
    case u'"':
        return u"&quot;";
    case u'\'':
        return u"&#39;";
    default:
        return {};
    }
}
} // namespace

void WriteEscaped(TextFileWriter& file, QStringView text) {
    qsizetype runStart = 0;
    for (qsizetype i = 0; i < text.size(); ++i) {
        const QStringView entity = entityFor(text[i].unicode());
        if (entity.isEmpty())
            continue;
        if (i > runStart)
            file.write(text.sliced(runStart, i - runStart));
        file.write(entity);
        runStart = i + 1;
    }
    if (runStart < text.size())
        file.write(text.sliced(runStart));
}

void WriteStripped(TextFileWriter& file, QStringView text) {
    qsizetype runStart = 0;
    for (qsizetype i = 0; i < text.size(); ++i) {
        const char16_t c = text[i].unicode();
        if (c != u'"' && c != u'\'' && c != u',')
            continue;
        if (i > runStart)
            file.write(text.sliced(runStart, i - runStart));
        runStart = i + 1;
    }
    if (runStart < text.size())
        file.write(text.sliced(runStart));
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
