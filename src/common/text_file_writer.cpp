#include "common/text_file_writer.h"

#include "common/failure.h"

#include <QFile>
#include <QFileInfo>
#include <algorithm>
#include <array>
#include <bit>
#include <cerrno>
#include <cstring>
#include <unicode/ucnv.h>
#include <unicode/ucnv_err.h>
#include <unicode/utf16.h>

namespace ardcard {

namespace {
// One large buffer between the encoder and the file: each write call to the
// system carries a megabyte, and stdio adds no second copy.
constexpr size_t kBufferBytes = size_t{1} << 20;

QString systemError(int err) {
    return QString::fromLocal8Bit(std::strerror(err));
}

// windows-1255 is a single-byte code page: each UTF-16 unit that it holds
// maps to one byte whatever surrounds it. The table keeps that byte for every
// unit, asked once of ICU itself; kNoByte marks the units ICU has to handle
// (unmappable characters and surrogates). A page of a million rows would
// otherwise spend a quarter of its time in the converter's generic path.
constexpr unsigned short kNoByte = 0x100;

constexpr char16_t kAlef = TextFileWriter::kAlef;
constexpr char16_t kTav = TextFileWriter::kTav;
constexpr unsigned kHebrewOffset = TextFileWriter::kHebrewOffset;

struct ByteTable {
    std::array<unsigned short, 0x10000> bytes{};
    // The table holds ASCII as itself and the letters at the fixed offset,
    // which is all the block encoder below assumes.
    bool fitsBlocks = false;
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
        fitsBlocks = true;
        for (char16_t c = 0; c < 0x80; ++c)
            fitsBlocks = fitsBlocks && bytes[c] == c;
        for (char16_t c = kAlef; c <= kTav; ++c)
            fitsBlocks = fitsBlocks && bytes[c] == c - kHebrewOffset;
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
    std::setvbuf(file_, nullptr, _IONBF, 0);
    table_ = byteTable().bytes.data();
    blocks_ = byteTable().fitsBlocks;
    // Not zeroed first: every byte is written before it goes to the file.
    buffer_ = std::make_unique_for_overwrite<char[]>(kBufferBytes);
    cur_ = buffer_.get();
    end_ = cur_ + kBufferBytes;
}

TextFileWriter::~TextFileWriter() {
    // On a failure path the file keeps what was written before the failure.
    if (!file_)
        return;
    try {
        settleHeldLead(nullptr, nullptr, nullptr);
        flushBuffer();
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
    cur_ = end_ = nullptr;
    throw Failure(what.arg(path_) + QStringLiteral(": ") + systemError(err), err);
}

void TextFileWriter::failClosed() const {
    throw Failure(QStringLiteral("הקובץ %1 כבר נסגר").arg(path_));
}

void TextFileWriter::writeGeneral(QStringView piece, const Rewrite& rewrite) {
    requireOpen();
    const auto* source = reinterpret_cast<const char16_t*>(piece.utf16());
    const char16_t* const end = source + piece.size();
    if (source == end)
        return;
    if (heldLead_ != 0)
        settleHeldLead(source, end, &source);
    constexpr size_t kMaxBytes = Rewrite::kMaxReplacement; // out of one unit
    // Locals, not members: stores through a char pointer may alias anything,
    // and the compiler would reload the members for every unit.
    const std::uint64_t bits = rewrite.bits;
    const unsigned short* const table = table_;
#if defined(__SSE2__)
    const detail::BlockEncoder encoder(rewrite);
    const bool blocks = blocks_;
#endif
    while (source < end) {
        makeRoom(kMaxBytes * 256);
        const auto room = static_cast<size_t>(end_ - cur_) / kMaxBytes;
        const char16_t* const stop = source + std::min(static_cast<size_t>(end - source), room);
        char* out = cur_;
        for (;;) {
#if defined(__SSE2__)
            // Each unit has room for kMaxBytes, so a block's eight bytes fit.
            if (blocks && stop - source >= detail::BlockEncoder::kUnits)
                out = encodeBlocks(encoder, source, stop, out);
#endif
            if (source == stop)
                break;
            // One unit through the table; the rewritten characters are all
            // ASCII, so their check comes first.
            const char16_t unit = *source;
            if (unit < 64 && ((bits >> unit) & 1) != 0) {
                const std::string_view with = rewrite.replacement(unit);
                if (!with.empty()) // an empty view may have no data pointer at all
                    std::memcpy(out, with.data(), with.size());
                out += with.size();
                ++source;
                continue;
            }
            const unsigned short byte = table[unit];
            if (byte == kNoByte)
                break;
            *out++ = static_cast<char>(byte);
            ++source;
        }
        cur_ = out;
        if (source < stop)
            source = convertUnmapped(source, end);
    }
}

#if defined(__SSE2__)
// Encodes source..stop (at least one block) into out, block by block, and
// the units no block takes one by one through the table, up to the first
// that needs more than the table; returns the end of the bytes and leaves
// `source` at the first unit not yet encoded.
char* TextFileWriter::encodeBlocks(const detail::BlockEncoder& encoder, const char16_t*& source,
                                   const char16_t* stop, char* out) const {
    const char16_t* const first = source;
    while (stop - source >= detail::BlockEncoder::kUnits) {
        const int done = encoder.encode(source, out);
        source += done;
        out += done;
        if (done < detail::BlockEncoder::kUnits)
            return out; // a unit no block takes: the caller's loop handles it
    }
    // Fewer than eight units left: the last eight units of the piece again
    // when all of them are plain. Plain units come out one byte each
    // whichever way they go, so the units before `source` that the block
    // repeats (all taken by blocks since `first`) have the same bytes just
    // before `out`.
    const auto left = static_cast<int>(stop - source);
    const char16_t* const last = stop - detail::BlockEncoder::kUnits;
    if (left > 0 && last >= first &&
        encoder.encodeIfPlain(last, out - (detail::BlockEncoder::kUnits - left))) {
        source = stop;
        out += left;
    }
    return out;
}
#endif

void TextFileWriter::writeAscii(std::string_view ascii, const Rewrite& rewrite) {
    requireOpen();
    settleHeldLead(nullptr, nullptr, nullptr);
    constexpr size_t kMaxBytes = Rewrite::kMaxReplacement;
    const std::uint64_t bits = rewrite.bits; // a local, as in write()
    while (!ascii.empty()) {
        makeRoom(kMaxBytes * 256);
        const size_t n = std::min(ascii.size(), static_cast<size_t>(end_ - cur_) / kMaxBytes);
        char* out = cur_;
        const char* const stop = ascii.data() + n;
        for (const char* p = ascii.data(); p < stop; ++p) {
            const char c = *p;
            const auto unit = static_cast<unsigned char>(c);
            if (unit < 64 && ((bits >> unit) & 1) != 0) {
                const std::string_view with = rewrite.replacement(unit);
                if (!with.empty()) // an empty view may have no data pointer at all
                    std::memcpy(out, with.data(), with.size());
                out += with.size();
            } else {
                *out++ = c;
            }
        }
        cur_ = out;
        ascii.remove_prefix(n);
    }
}

void TextFileWriter::writeAsciiSlow(std::string_view ascii) {
    requireOpen();
    settleHeldLead(nullptr, nullptr, nullptr);
    while (!ascii.empty()) {
        if (cur_ == end_)
            flushBuffer();
        const size_t n = std::min(ascii.size(), static_cast<size_t>(end_ - cur_));
        std::memcpy(cur_, ascii.data(), n);
        cur_ += n;
        ascii.remove_prefix(n);
    }
}

void TextFileWriter::makeAsciiRoom(size_t most) {
    requireOpen();
    settleHeldLead(nullptr, nullptr, nullptr);
    if (most >= static_cast<size_t>(end_ - cur_))
        flushBuffer();
}

// A stretch the table cannot map (unmappable characters, surrogates) goes
// through ICU with the writer's own callback; returns where the stretch ends.
const char16_t* TextFileWriter::convertUnmapped(const char16_t* source, const char16_t* end) {
    const char16_t* stretchEnd = source;
    while (stretchEnd < end && table_[*stretchEnd] == kNoByte)
        ++stretchEnd;
    const char16_t* resume = stretchEnd;
    if (stretchEnd == end && U16_IS_LEAD(end[-1])) {
        heldLead_ = end[-1];
        --stretchEnd;
    }
    if (source < stretchEnd)
        convertWithIcu(source, stretchEnd);
    return resume;
}

// The held high surrogate, with the low surrogate that starts the next
// piece when there is one (then *resume steps past it); alone otherwise, or
// when no text follows (`next` null), where ICU treats it as a lone unit.
void TextFileWriter::settleHeldLead(const char16_t* next, const char16_t* end,
                                    const char16_t** resume) {
    if (heldLead_ == 0)
        return;
    const char16_t pair[2] = {heldLead_, next && next < end ? *next : u'\0'};
    heldLead_ = 0;
    if (next && next < end && U16_IS_TRAIL(*next)) {
        convertWithIcu(pair, pair + 2);
        *resume = next + 1;
    } else {
        convertWithIcu(pair, pair + 1);
    }
}

void TextFileWriter::convertWithIcu(const char16_t* source, const char16_t* end) {
    const auto* from = reinterpret_cast<const UChar*>(source);
    const auto* const fromEnd = reinterpret_cast<const UChar*>(end);
    for (;;) {
        UErrorCode status = U_ZERO_ERROR;
        ucnv_fromUnicode(converter_.get(), &cur_, end_, &from, fromEnd, nullptr, true, &status);
        if (status == U_BUFFER_OVERFLOW_ERROR) {
            flushBuffer(); // ICU keeps what did not fit and goes on
            continue;
        }
        if (U_FAILURE(status))
            throw Failure(QStringLiteral("שגיאה בהמרת הטקסט לקוד windows-1255: ") +
                          QString::fromLatin1(u_errorName(status)));
        break;
    }
    if (from != fromEnd)
        throw Failure(QStringLiteral("שגיאה בהמרת הטקסט לקוד windows-1255"));
}

void TextFileWriter::flushBuffer() {
    const auto bytes = static_cast<size_t>(cur_ - buffer_.get());
    cur_ = buffer_.get();
    if (bytes > 0 && std::fwrite(buffer_.get(), 1, bytes, file_) != bytes)
        fail(QStringLiteral("שגיאה בכתיבת הקובץ %1"), errno);
}

void TextFileWriter::close() {
    if (!file_)
        return;
    settleHeldLead(nullptr, nullptr, nullptr);
    flushBuffer();
    std::FILE* f = file_;
    file_ = nullptr;
    cur_ = end_ = nullptr;
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
