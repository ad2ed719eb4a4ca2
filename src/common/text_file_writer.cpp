#include "common/text_file_writer.h"

#include "common/failure.h"

#include <QFile>
#include <QFileInfo>
#include <cerrno>
#include <cstring>
#include <unicode/ucnv.h>
#include <unicode/ucnv_err.h>

namespace ardcard {

namespace {
constexpr size_t kPendingChars = 64 * 1024;

QString systemError(int err) {
    return QString::fromLocal8Bit(std::strerror(err));
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
    const UChar* source = reinterpret_cast<const UChar*>(pending_.data());
    const UChar* sourceEnd = source + pending_.size();
    // A character reference may take up to 10 bytes for one UTF-16 unit.
    encoded_.resize(pending_.size() * 10 + 16);
    char* target = encoded_.data();
    UErrorCode status = U_ZERO_ERROR;
    ucnv_fromUnicode(converter_.get(), &target, encoded_.data() + encoded_.size(), &source,
                     sourceEnd, nullptr, last, &status);
    if (U_FAILURE(status))
        throw Failure(QStringLiteral("שגיאה בהמרת הטקסט לקוד windows-1255: ") +
                      QString::fromLatin1(u_errorName(status)));
    pending_.erase(0,
                   static_cast<size_t>(source - reinterpret_cast<const UChar*>(pending_.data())));
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
