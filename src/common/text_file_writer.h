#pragma once

#include <QString>
#include <QStringView>
#include <cstdint>
#include <cstdio>
#include <cstring>
#include <memory>
#include <string_view>

struct UConverter;

namespace ardcard {

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
        std::uint64_t bits = 0;
        std::string_view (*replacement)(char16_t) = nullptr;
    };

    void write(QStringView piece) { write(piece, Rewrite{}); }
    void write(QStringView piece, const Rewrite& rewrite);
    // ASCII text (markup, digits): the same bytes in windows-1255, so it
    // skips the encoding step. Every byte must be below 0x80.
    void writeAscii(std::string_view ascii) {
        // Strictly less: a closed writer has no buffer (both null) and must
        // reach the slow path, which reports it.
        if (heldLead_ == 0 && ascii.size() < static_cast<size_t>(end_ - cur_)) {
            std::memcpy(cur_, ascii.data(), ascii.size());
            cur_ += ascii.size();
            return;
        }
        writeAsciiSlow(ascii);
    }
    void writeAscii(std::string_view ascii, const Rewrite& rewrite);
    void endLine() { writeAscii("\r\n"); }
    void writeLine(QStringView line) {
        write(line);
        endLine();
    }
    // Flushes and closes; throws when the data did not reach the file.
    void close();

    const QString& path() const { return path_; }

private:
    void writeAsciiSlow(std::string_view ascii);
    void makeRoom(size_t bytes);
    const char16_t* convertUnmapped(const char16_t* source, const char16_t* end);
    void convertWithIcu(const char16_t* source, const char16_t* end);
    void settleHeldLead(const char16_t* next, const char16_t* end, const char16_t** resume);
    void flushBuffer();
    void requireOpen() const;
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
    // Encoded bytes not yet in the file: buffer_[0 .. cur_); end_ is the
    // buffer's end, and both are null once the file is closed.
    std::unique_ptr<char[]> buffer_;
    char* cur_ = nullptr;
    char* end_ = nullptr;
    // A high surrogate at the end of a piece waits for its other half, which
    // may start the next piece.
    char16_t heldLead_ = 0;
};

} // namespace ardcard
