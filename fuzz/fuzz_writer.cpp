// The windows-1255 writer on any UTF-16 text, in both modes: it never
// crashes, writes whole lines, and keeps the characters the code page holds.
#include "common/text_file_writer.h"

#include <QDir>
#include <QFile>
#include <cstdlib>
#include <unistd.h>

using namespace ardcard;

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    if (size < 1)
        return 0;
    const auto mode = (data[0] & 1) ? TextFileWriter::Unmappable::QuestionMark
                                    : TextFileWriter::Unmappable::CharacterReference;
    const QString text = QString::fromUtf16(reinterpret_cast<const char16_t*>(data + 1),
                                            static_cast<qsizetype>((size - 1) / 2));
    static const QString path =
        QDir::tempPath() + QStringLiteral("/ardcard-fuzz-writer-%1.txt").arg(getpid());
    {
        TextFileWriter w(path, mode);
        // in pieces, split at arbitrary places (also inside surrogate pairs)
        const qsizetype cut = text.isEmpty() ? 0 : (data[0] >> 1) % (text.size() + 1);
        w.write(QStringView(text).left(cut));
        w.write(QStringView(text).mid(cut));
        w.endLine();
        w.close();
    }
    QFile f(path);
    if (!f.open(QIODevice::ReadOnly))
        std::abort();
    const QByteArray bytes = f.readAll();
    if (!bytes.endsWith("\r\n"))
        std::abort();
    const QByteArray ascii = text.toLatin1();
    bool plainAscii = true;
    for (const QChar c : text)
        plainAscii = plainAscii && c.unicode() < 0x80;
    if (plainAscii && bytes != ascii + "\r\n")
        std::abort();
    return 0;
}
