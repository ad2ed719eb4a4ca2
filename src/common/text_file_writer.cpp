#include "common/text_file_writer.h"

#include "common/failure.h"

#include <QFile>
#include <QFileInfo>
#include <array>
#include <cerrno>
#include <cstring>
#include <unicode/ucnv.h>
#include <unicode/ucnv_err.h>
#include <unicode/utf16.h>

namespace ardcard {

namespace {
constexpr size_t kPendingChars = 64 * 1024;

QString systemError(int err) {
    return QString::fromLocal8Bit(std::strerror(err));
}

// windows-1255 is a single-byte code page: each UTF-16 unit that it holds
// maps to one byte whatever surrounds it. The table keeps that byte for every
// unit, asked once of ICU itself; kNoByte marks the units ICU has to handle
// (unmappable characters and surrogates). A page of a million rows would
// otherwise spend a quarter of its time in the converter's generic path.
constexpr unsigned short kNoByte = 0x100;

struct ByteTable {
    std::array<unsigned short, 0x10000> bytes{};
    ByteTable() {
        bytes.fill(kNoByte);
        UErrorCode status = U_ZERO_ERROR;
        UConverter* conv = ucnv_open("windows-1255", &status);
        if (U_FAILURE(status))
            return; // every unit goes through ICU, which reports the failure itself
        ucnv_setFromUCallBack(conv, UCNV_FROM_U_CALLBACK_STOP, nullptr, nullptr, nullptr, &status);
        for (char32_t c = 0; c < 0x10000; ++c) {
            if (c >= 0xD800 && c <= 0xDFFF)
                continue;
            const UChar unit = static_cast<UChar>(c);
            char out[8];
            status = U_ZERO_ERROR;
            const int32_t n = ucnv_fromUChars(conv, out, sizeof out, &unit, 1, &status);
            if (U_SUCCESS(status) && n == 1)
                bytes[c] = static_cast<unsigned char>(out[0]);
            ucnv_reset(conv);
        }
        ucnv_close(conv);
    }
};

const ByteTable& byteTable() {
    static const ByteTable table;
    return table;
}
} // namespace

TextFileWriter::TextFileWriter(const QString& path, Unmappable mode) : path_(path) {
    UErrorCode status = U_ZERO_ERROR;
    converter_.reset(ucnv_open("windows-1255", &status));
    if (U_FAILURE(status))
        throw Failure(QStringLiteral("אין ממיר לקוד windows-1255: ") +
                      QString::fromLatin1(u_errorName(status)));
    if (mode == Unmappable::CharacterReference) {
        ucnv_setFromUCallBack(converter_.get(), UCNV_FROM_U_CALLBACK_ESCAPE, UCNV_ESCAPE_XML_DEC,
                              nullptr, nullptr, &status);
    } else {
        ucnv_setSubstChars(converter_.get(), "?", 1, &status);
        ucnv_setFromUCallBack(converter_.get(), UCNV_FROM_U_CALLBACK_SUBSTITUTE, nullptr, nullptr,
                              nullptr, &status);
    }

    const QFileInfo info(path);
    if (info.exists() || info.isSymLink()) {
        QFile existing(path);
        if (!existing.remove())
            throw Failure(
                QStringLiteral("לא ניתן למחוק את הקובץ %1: %2").arg(path, existing.errorString()));
    }
    file_ = std::fopen(QFile::encodeName(path).constData(), "wbx");
    if (!file_)
        fail(QStringLiteral("לא ניתן ליצור את הקובץ %1"), errno);
    pending_.reserve(kPendingChars + 1024);
}

TextFileWriter::~TextFileWriter() {
    // On a failure path the file keeps what was written before the failure.
    if (!file_)
        return;
    try {
        flushPending(true);
    } catch (...) {
        // the failure that ended the writing is the one worth reporting
    }
    if (file_)
        std::fclose(file_);
}

void TextFileWriter::ConverterClose::operator()(UConverter* c) const {
    ucnv_close(c);
}

void TextFileWriter::fail(const QString& what, int err) {
    if (file_) {
        std::fclose(file_);
        file_ = nullptr;
    }
    throw Failure(what.arg(path_) + QStringLiteral(": ") + systemError(err), err);
}

void TextFileWriter::write(QStringView piece) {
    if (!file_)
        throw Failure(QStringLiteral("הקובץ %1 כבר נסגר").arg(path_));
    pending_.append(reinterpret_cast<const char16_t*>(piece.utf16()),
                    static_cast<size_t>(piece.size()));
    if (pending_.size() >= kPendingChars)
        flushPending(false);
}

void TextFileWriter::endLine() {
    write(u"\r\n");
}

void TextFileWriter::flushPending(bool last) {
    const auto& table = byteTable().bytes;
    const UChar* const begin = reinterpret_cast<const UChar*>(pending_.data());
    const UChar* source = begin;
    const UChar* sourceEnd = begin + pending_.size();
    // A high surrogate at the end waits for its other half in the next piece.
    if (!last && source < sourceEnd && U16_IS_LEAD(sourceEnd[-1]))
        --sourceEnd;
    // A character reference may take up to 10 bytes for one UTF-16 unit.
    encoded_.resize(pending_.size() * 10 + 16);
    char* target = encoded_.data();
    char* const targetEnd = encoded_.data() + encoded_.size();
    while (source < sourceEnd) {
        if (table[*source] != kNoByte) {
            *target++ = static_cast<char>(table[*source++]);
            continue;
        }
        // A stretch the table cannot map (a pair of surrogates stays in one
        // stretch) goes through ICU with the writer's own callback.
        const UChar* stretchEnd = source;
        while (stretchEnd < sourceEnd && table[*stretchEnd] == kNoByte)
            ++stretchEnd;
        UErrorCode status = U_ZERO_ERROR;
        ucnv_fromUnicode(converter_.get(), &target, targetEnd, &source, stretchEnd, nullptr, true,
                         &status);
        if (U_FAILURE(status))
            throw Failure(QStringLiteral("שגיאה בהמרת הטקסט לקוד windows-1255: ") +
                          QString::fromLatin1(u_errorName(status)));
        if (source != stretchEnd)
            throw Failure(QStringLiteral("שגיאה בהמרת הטקסט לקוד windows-1255"));
    }
    pending_.erase(0, static_cast<size_t>(source - begin));
    const size_t bytes = static_cast<size_t>(target - encoded_.data());
    if (bytes > 0 && std::fwrite(encoded_.data(), 1, bytes, file_) != bytes)
        fail(QStringLiteral("שגיאה בכתיבת הקובץ %1"), errno);
}

void TextFileWriter::close() {
    if (!file_)
        return;
    flushPending(true);
    std::FILE* f = file_;
    file_ = nullptr;
    if (std::fflush(f) != 0) {
        const int err = errno;
        std::fclose(f);
        throw Failure(QStringLiteral("שגיאה בכתיבת הקובץ %1: ").arg(path_) + systemError(err), err);
    }
    if (std::fclose(f) != 0)
        throw Failure(QStringLiteral("שגיאה בסגירת הקובץ %1: ").arg(path_) + systemError(errno),
                      errno);
}

} // namespace ardcard
