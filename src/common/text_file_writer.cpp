#include "common/text_file_writer.h"

#include "common/failure.h"

#include <QFile>
#include <QFileInfo>
#include <algorithm>
#include <array>
#include <cerrno>
#include <cstring>
#include <unicode/ucnv.h>
#include <unicode/ucnv_err.h>
#include <unicode/utf16.h>

namespace ardcard {

namespace {

// The most ICU writes for one character: "&#1114111;".
constexpr std::size_t kMostPerCharacter = 16;

QString systemError(int err) {
    return QString::fromLocal8Bit(std::strerror(err));
}

// windows-1255 is a single-byte code page: each UTF-16 unit it holds maps to
// one byte whatever surrounds it. The table keeps that byte for every unit,
// asked once of ICU itself; kNoByte marks the units ICU has to handle
// (characters outside the code page, surrogates). Going through the
// converter for every character would cost a large page a quarter of its
// time.
constexpr unsigned short kNoByte = 0x100;

const std::array<unsigned short, 0x10000>& byteTable() {
    static const auto table = [] {
        std::array<unsigned short, 0x10000> bytes{};
        bytes.fill(kNoByte);
        UErrorCode status = U_ZERO_ERROR;
        UConverter* conv = ucnv_open("windows-1255", &status);
        if (U_FAILURE(status))
            return bytes; // every unit goes through ICU, which reports the failure itself
        ucnv_setFromUCallBack(conv, UCNV_FROM_U_CALLBACK_STOP, nullptr, nullptr, nullptr, &status);
        for (char32_t c = 0; c < 0x10000; ++c) {
            if (U16_IS_SURROGATE(c))
                continue;
            const auto unit = static_cast<UChar>(c);
            char out[8];
            status = U_ZERO_ERROR;
            const int32_t n = ucnv_fromUChars(conv, out, sizeof out, &unit, 1, &status);
            if (U_SUCCESS(status) && n == 1)
                bytes[c] = static_cast<unsigned char>(out[0]);
            ucnv_reset(conv);
        }
        ucnv_close(conv);
        return bytes;
    }();
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
    // "x": a file that appeared since the removal is not written through.
    file_ = std::fopen(QFile::encodeName(path).constData(), "wbx");
    if (!file_)
        fail(QStringLiteral("לא ניתן ליצור את הקובץ %1"), errno);
    // Each write call to the system carries the whole buffer, a megabyte,
    // and stdio adds no second copy.
    std::setvbuf(file_, nullptr, _IONBF, 0);
    buffer_ = std::make_unique_for_overwrite<char[]>(kBufferBytes);
}

TextFileWriter::~TextFileWriter() {
    // On a failure path the file keeps what was written before the failure.
    if (!file_)
        return;
    try {
        const char16_t* ignored = nullptr;
        writeHeldLead(nullptr, nullptr, ignored);
        flush();
    } catch (const Failure&) {
        // the failure that ended the writing is the one worth reporting
    }
    if (file_)
        std::fclose(file_);
}

void TextFileWriter::ConverterClose::operator()(UConverter* c) const {
    ucnv_close(c);
}

void TextFileWriter::write(QStringView text) {
    requireOpen();
    const auto& table = byteTable();
    const auto* source = reinterpret_cast<const char16_t*>(text.utf16());
    const char16_t* const end = source + text.size();
    if (heldLead_ != 0 && source < end)
        writeHeldLead(source, end, source);
    while (source < end) {
        if (used_ == kBufferBytes)
            flush();
        // Units the table maps, as far as the buffer has room.
        const std::size_t room = std::min<std::size_t>(kBufferBytes - used_, end - source);
        char* out = buffer_.get() + used_;
        const char16_t* const stop = source + room;
        for (; source < stop; ++source) {
            const unsigned short byte = table[*source];
            if (byte == kNoByte)
                break;
            *out++ = static_cast<char>(byte);
        }
        used_ = static_cast<std::size_t>(out - buffer_.get());
        if (source == stop)
            continue;
        // A stretch the table cannot map goes through ICU with the writer's
        // own callback; a high surrogate that ends the piece waits for the
        // next one.
        const char16_t* stretchEnd = source;
        while (stretchEnd < end && table[*stretchEnd] == kNoByte)
            ++stretchEnd;
        const char16_t* const resume = stretchEnd;
        if (stretchEnd == end && U16_IS_LEAD(end[-1])) {
            heldLead_ = end[-1];
            --stretchEnd;
        }
        if (source < stretchEnd)
            convertWithIcu(source, stretchEnd);
        source = resume;
    }
}

void TextFileWriter::writeAsciiInPieces(std::string_view ascii) {
    requireOpen();
    const char16_t* ignored = nullptr;
    writeHeldLead(nullptr, nullptr, ignored);
    while (!ascii.empty()) {
        if (used_ == kBufferBytes)
            flush();
        const std::size_t n = std::min(ascii.size(), kBufferBytes - used_);
        std::memcpy(buffer_.get() + used_, ascii.data(), n);
        used_ += n;
        ascii.remove_prefix(n);
    }
}

// The held high surrogate, with the low surrogate that starts the next piece
// when there is one (then `resume` steps past it); alone otherwise, or when
// no text follows (`next` null), where ICU treats it as a lone unit.
void TextFileWriter::writeHeldLead(const char16_t* next, const char16_t* end,
                                   const char16_t*& resume) {
    if (heldLead_ == 0)
        return;
    const bool paired = next && next < end && U16_IS_TRAIL(*next);
    const char16_t pair[2] = {heldLead_, paired ? *next : u'\0'};
    heldLead_ = 0;
    convertWithIcu(pair, pair + (paired ? 2 : 1));
    if (paired)
        resume = next + 1;
}

void TextFileWriter::convertWithIcu(const char16_t* begin, const char16_t* end) {
    const auto* from = reinterpret_cast<const UChar*>(begin);
    const auto* const fromEnd = reinterpret_cast<const UChar*>(end);
    while (from < fromEnd) {
        if (kBufferBytes - used_ < kMostPerCharacter)
            flush();
        char* out = buffer_.get() + used_;
        UErrorCode status = U_ZERO_ERROR;
        ucnv_fromUnicode(converter_.get(), &out, buffer_.get() + kBufferBytes, &from, fromEnd,
                         nullptr, true, &status);
        used_ = static_cast<std::size_t>(out - buffer_.get());
        if (status == U_BUFFER_OVERFLOW_ERROR)
            continue; // ICU keeps what did not fit; the next round flushes first
        if (U_FAILURE(status))
            throw Failure(QStringLiteral("שגיאה בהמרת הטקסט לקוד windows-1255: ") +
                          QString::fromLatin1(u_errorName(status)));
    }
}

void TextFileWriter::flush() {
    const std::size_t bytes = used_;
    used_ = 0;
    if (bytes > 0 && std::fwrite(buffer_.get(), 1, bytes, file_) != bytes)
        fail(QStringLiteral("שגיאה בכתיבת הקובץ %1"), errno);
}

void TextFileWriter::requireOpen() const {
    if (!file_)
        throw Failure(QStringLiteral("הקובץ %1 כבר נסגר").arg(path_));
}

void TextFileWriter::fail(const QString& what, int err) {
    if (file_) {
        std::fclose(file_);
        file_ = nullptr;
    }
    throw Failure(what.arg(path_) + QStringLiteral(": ") + systemError(err), err);
}

void TextFileWriter::close() {
    if (!file_)
        return;
    const char16_t* ignored = nullptr;
    writeHeldLead(nullptr, nullptr, ignored);
    flush();
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
