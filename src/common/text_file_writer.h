#pragma once

#include "common/copy_bytes.h"

#include <QString>
#include <QStringView>
#include <array>
#include <bit>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <memory>
#include <string_view>

#if defined(__SSE2__)
#include <emmintrin.h>
#endif

struct UConverter;

namespace ardcard {

namespace detail {
class BlockEncoder;
}

// Writes one output file in the windows-1255 code page, every line ended by
// CR LF; a line may be written in pieces. Opening deletes a file of the same
// name first. The file is closed by close() or, on any failure path, by the
// destructor, which keeps what was written so far; so no error leaves a file
// open. Failures throw Failure.
//
// Text is encoded as it is written, straight into one large buffer that goes
// to the file when full: a page of a million rows costs little more than
// writing its bytes.
class TextFileWriter {
public:
    // What becomes of a character that windows-1255 cannot hold.
    enum class Unmappable {
        CharacterReference, // "&#128512;", for pages
        QuestionMark,       // "?", for the CSV file
    };

    TextFileWriter(const QString& path, Unmappable mode);
    ~TextFileWriter();
    TextFileWriter(const TextFileWriter&) = delete;
    TextFileWriter& operator=(const TextFileWriter&) = delete;

    // Characters below 64 that a caller writes differently (a page's
    // entities, a CSV field's dropped separators): each one whose bit is set
    // in `bits` is written as replacement(c), at most kMaxReplacement bytes
    // of ASCII (nothing when empty). Done while encoding, in the same pass.
    struct Rewrite {
        static constexpr size_t kMaxReplacement = 8;
        // The rewritten characters one by one as well (up to kMaxListed of
        // them), each repeated in eight lanes, so that the encoder finds all
        // of them in eight units at once; a longer set makes it take every
        // unit below 64 singly.
        static constexpr int kMaxListed = 5;
        using Lanes = std::array<char16_t, 8>;

        std::uint64_t bits = 0;
        std::string_view (*replacement)(char16_t) = nullptr;
        alignas(16) std::array<Lanes, kMaxListed> listed{};
        size_t listedCount = 0; // the places of `listed` in use
        // The first unit that can be plain ASCII (0 or 64), top bit flipped
        // for the encoder's signed compare.
        alignas(16) Lanes asciiFrom = lanesOf(0x8000);

        constexpr Rewrite() = default;
        constexpr Rewrite(std::uint64_t setBits, std::string_view (*with)(char16_t))
            : bits(setBits), replacement(with) {
            size_t count = 0;
            for (int c = 0; c < 64; ++c) {
                if (((setBits >> c) & 1) == 0)
                    continue;
                if (count < listed.size())
                    listed[count] = lanesOf(static_cast<char16_t>(c));
                ++count;
            }
            listedCount = count < listed.size() ? count : listed.size();
            if (count > listed.size())
                asciiFrom = lanesOf(0x8000 + 64);
        }

    private:
        static constexpr Lanes lanesOf(char16_t c) { return {c, c, c, c, c, c, c, c}; }
    };

    void write(QStringView piece);
    void write(QStringView piece, const Rewrite& rewrite) {
        if (piece.size() <= kShortPiece && encodeShort(piece, rewrite))
            return;
        writeGeneral(piece, rewrite);
    }
    // The same bytes as write(), always by the general encoder (blocks of
    // eight units, the table, ICU); write() takes it for all but short
    // pieces of plain text.
    void writeGeneral(QStringView piece, const Rewrite& rewrite);
    // ASCII text (markup, digits): the same bytes in windows-1255, so it
    // skips the encoding step. Every byte must be below 0x80.
    void writeAscii(std::string_view ascii) {
        // Strictly less: a closed writer has no buffer (both null) and must
        // reach the slow path, which reports it.
        if (heldLead_ == 0 && ascii.size() < static_cast<size_t>(end_ - cur_)) {
            CopyBytes(cur_, ascii.data(), ascii.size());
            cur_ += ascii.size();
            return;
        }
        writeAsciiSlow(ascii);
    }
    void writeAscii(std::string_view ascii, const Rewrite& rewrite);
    // Room for up to `most` bytes of ASCII written in place, for a caller
    // that formats numbers straight into the file's buffer rather than into
    // a scratch of its own first; it hands the end of what it wrote to
    // commitAscii() before any other write. Every byte must be below 0x80,
    // and `most` far below the buffer's size (some kilobytes at most).
    char* asciiRoom(size_t most) {
        // Strictly less, as in writeAscii: a closed writer has no room.
        if (heldLead_ != 0 || most >= static_cast<size_t>(end_ - cur_))
            makeAsciiRoom(most);
        return cur_;
    }
    void commitAscii(char* end) { cur_ = end; }
    void endLine() { writeAscii("\r\n"); }
    void writeLine(QStringView line) {
        write(line);
        endLine();
    }
    // Flushes and closes; throws when the data did not reach the file.
    void close();

    const QString& path() const { return path_; }

    // The Hebrew letters alef to tav, which windows-1255 holds at 0xE0 to
    // 0xFA: a fixed offset.
    static constexpr char16_t kAlef = 0x05D0;
    static constexpr char16_t kTav = 0x05EA;
    static constexpr unsigned kHebrewOffset = kAlef - 0xE0;
    // Pieces up to this length may take encodeShort().
    static constexpr qsizetype kShortPiece = 24;

private:
    // Most pieces of text are a field of a few characters, ASCII and Hebrew
    // letters, whose bytes follow by arithmetic: encoding them unit by unit
    // here skips the general path's setup, which costs more than such a
    // piece itself. All or nothing: on the first unit it does not take
    // (any other character, a held surrogate half, too little room, a table
    // that does not fit the arithmetic) it writes nothing and returns false,
    // and the general path starts the piece afresh.
    bool encodeShort(QStringView piece, const Rewrite& rewrite) {
        const auto n = static_cast<size_t>(piece.size());
        // Strictly less, as in writeAscii: a closed writer has no room.
        if (heldLead_ != 0 || !blocks_ ||
            n * Rewrite::kMaxReplacement >= static_cast<size_t>(end_ - cur_))
            return false;
        const auto* source = reinterpret_cast<const char16_t*>(piece.utf16());
        if (n >= 8 && encodeShortBlocks(source, n, rewrite, cur_)) {
            cur_ += n;
            return true;
        }
        const std::uint64_t bits = rewrite.bits; // a local: `out` may alias anything
        char* out = cur_;
        for (size_t i = 0; i < n; ++i) {
            const char16_t unit = source[i];
            if (unit < 64 && ((bits >> unit) & 1) != 0) {
                const std::string_view with = rewrite.replacement(unit);
                CopyBytes(out, with.data(), with.size());
                out += with.size();
            } else if (unit < 0x80) {
                *out++ = static_cast<char>(unit);
            } else if (unit >= kAlef && unit <= kTav) {
                *out++ = static_cast<char>(unit - kHebrewOffset);
            } else {
                return false;
            }
        }
        cur_ = out;
        return true;
    }
    // A piece of 8 to 24 units that is all plain (ASCII not rewritten,
    // Hebrew letters), as two or three overlapping blocks of eight units
    // that stay inside the piece: each unit's byte lands in its own place,
    // whichever block writes it last. False when a unit is not plain; the caller then
    // goes unit by unit over what was written here. Shorter pieces cost less
    // unit by unit than the blocks' checks. Inline, so that a caller's
    // constant rewrite set folds into the checks.
    [[gnu::always_inline]] static bool encodeShortBlocks(const char16_t* source, size_t n,
                                                         const Rewrite& rewrite, char* out);
    void writeAsciiSlow(std::string_view ascii);
    void makeAsciiRoom(size_t most);
    void makeRoom(size_t bytes) {
        if (static_cast<size_t>(end_ - cur_) < bytes)
            flushBuffer();
    }
    char* encodeBlocks(const detail::BlockEncoder& encoder, const char16_t*& source,
                       const char16_t* stop, char* out) const;
    const char16_t* convertUnmapped(const char16_t* source, const char16_t* end);
    void convertWithIcu(const char16_t* source, const char16_t* end);
    void settleHeldLead(const char16_t* next, const char16_t* end, const char16_t** resume);
    void flushBuffer();
    void requireOpen() const {
        if (!file_)
            failClosed();
    }
    [[noreturn]] void failClosed() const;
    [[noreturn]] void fail(const QString& what, int err);

    QString path_;
    std::FILE* file_ = nullptr;
    struct ConverterClose {
        void operator()(UConverter* c) const;
    };
    std::unique_ptr<UConverter, ConverterClose> converter_;
    // windows-1255 byte of each UTF-16 unit, or a mark for the units ICU
    // handles; shared by every writer.
    const unsigned short* table_ = nullptr;
    // Whether the table agrees with the eight-at-a-time encoding (ASCII as
    // itself, the Hebrew letters by a fixed offset); it does for every ICU
    // seen so far, and the writer goes unit by unit otherwise.
    bool blocks_ = false;
    // Encoded bytes not yet in the file: buffer_[0 .. cur_); end_ is the
    // buffer's end, and both are null once the file is closed.
    std::unique_ptr<char[]> buffer_;
    char* cur_ = nullptr;
    char* end_ = nullptr;
    // A high surrogate at the end of a piece waits for its other half, which
    // may start the next piece.
    char16_t heldLead_ = 0;
};

namespace detail {
#if defined(__SSE2__)
// Text is mostly ASCII and Hebrew letters, whose bytes follow from the units
// by arithmetic: eight units are checked and encoded at once (SSE2 is part of
// every x86-64). A block holding anything else, or a character the caller
// rewrites, is encoded as far as its plain prefix and the rest goes unit by
// unit through the table.
class BlockEncoder {
public:
    explicit BlockEncoder(const TextFileWriter::Rewrite& rewrite) : rewrite_(rewrite) {}

    static constexpr int kUnits = 8;

    // Encodes source[0..8) into out[0..8) when all eight units are plain:
    // ASCII the caller does not rewrite, or Hebrew letters.
    bool encodeIfPlain(const char16_t* source, char* out) const {
        const __m128i units = load(source);
        if (_mm_movemask_epi8(plainLanes(units)) != 0xFFFF)
            return false;
        store(units, out);
        return true;
    }

    // Encodes source[0..8) into out[0..8) and returns plainPrefix(source):
    // the bytes of the plain units are right, those after them are to be
    // written over.
    int encode(const char16_t* source, char* out) const {
        const __m128i units = load(source);
        store(units, out);
        const __m128i plain = plainLanes(units);
        return std::countr_one(static_cast<unsigned>(_mm_movemask_epi8(plain))) / 2;
    }

private:
    // The byte of every ASCII unit and letter; garbage for other units.
    static void store(__m128i units, char* out) {
        _mm_storel_epi64(reinterpret_cast<__m128i*>(out), packed(units));
    }
    static __m128i packed(__m128i units) {
        const __m128i letter = letterLanes(units);
        const __m128i bytes = _mm_sub_epi16(
            units, _mm_and_si128(
                       letter, _mm_set1_epi16(static_cast<short>(TextFileWriter::kHebrewOffset))));
        return _mm_packus_epi16(bytes, bytes);
    }
    static __m128i load(const char16_t* source) {
        return _mm_loadu_si128(reinterpret_cast<const __m128i*>(source));
    }
    // SSE2 compares 16-bit lanes as signed: flipping the top bit makes the
    // signed order the unsigned one.
    static __m128i flipped(__m128i units) {
        return _mm_xor_si128(units, _mm_set1_epi16(static_cast<short>(-0x8000)));
    }
    static __m128i letterLanes(__m128i units) {
        const __m128i fromAlef =
            _mm_sub_epi16(units, _mm_set1_epi16(static_cast<short>(TextFileWriter::kAlef)));
        return _mm_cmplt_epi16(flipped(fromAlef),
                               _mm_set1_epi16(static_cast<short>(
                                   TextFileWriter::kTav - TextFileWriter::kAlef + 1 - 0x8000)));
    }
    static __m128i lanes(const TextFileWriter::Rewrite::Lanes& l) {
        return _mm_load_si128(reinterpret_cast<const __m128i*>(l.data()));
    }
    __m128i plainLanes(__m128i units) const {
        const __m128i f = flipped(units);
        const __m128i ascii = _mm_andnot_si128(_mm_cmplt_epi16(f, lanes(rewrite_.asciiFrom)),
                                               _mm_cmplt_epi16(f, asciiEnd()));
        __m128i rewritten = _mm_setzero_si128();
        for (size_t i = 0; i < rewrite_.listedCount; ++i)
            rewritten = _mm_or_si128(rewritten, _mm_cmpeq_epi16(units, lanes(rewrite_.listed[i])));
        return _mm_andnot_si128(rewritten, _mm_or_si128(ascii, letterLanes(units)));
    }
    static __m128i asciiEnd() { return _mm_set1_epi16(static_cast<short>(0x80 - 0x8000)); }

    const TextFileWriter::Rewrite& rewrite_;
};
#endif
} // namespace detail

// Nothing rewritten: the plain write().
inline constexpr TextFileWriter::Rewrite kNoRewrite{};

[[gnu::always_inline]] inline bool TextFileWriter::encodeShortBlocks(const char16_t* source,
                                                                     size_t n,
                                                                     const Rewrite& rewrite,
                                                                     char* out) {
#if defined(__SSE2__)
    const detail::BlockEncoder encoder(rewrite);
    // [0, 8), [8, 16) past 16 units, and the last eight cover the piece.
    return encoder.encodeIfPlain(source, out) &&
           (n <= 16 || encoder.encodeIfPlain(source + 8, out + 8)) &&
           encoder.encodeIfPlain(source + n - 8, out + n - 8);
#else
    (void)source, (void)n, (void)rewrite, (void)out;
    return false;
#endif
}

inline void TextFileWriter::write(QStringView piece) {
    write(piece, kNoRewrite);
}

} // namespace ardcard
