#pragma once

#include <QString>
#include <QStringView>
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
// Text is encoded as it is written into one buffer that goes to the file
// when full: a page of a million rows costs little more than its bytes.
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

    void write(QStringView text);
    // ASCII text (markup, digits) is the same bytes in windows-1255, so it
    // skips the encoding step. Every byte must be below 0x80. Most pieces
    // are a few bytes that fit the buffer: they are copied here, inline.
    void writeAscii(std::string_view ascii) {
        if (heldLead_ == 0 && file_ && ascii.size() <= kBufferBytes - used_) {
            std::memcpy(buffer_.get() + used_, ascii.data(), ascii.size());
            used_ += ascii.size();
            return;
        }
        writeAsciiInPieces(ascii);
    }
    void endLine() { writeAscii("\r\n"); }
    void writeLine(QStringView line) {
        write(line);
        endLine();
    }
    // Flushes and closes; throws when the data did not reach the file.
    void close();

    const QString& path() const { return path_; }

private:
    static constexpr std::size_t kBufferBytes = std::size_t{1} << 20;

    void writeAsciiInPieces(std::string_view ascii);
    void requireOpen() const;
    void convertWithIcu(const char16_t* begin, const char16_t* end);
    void writeHeldLead(const char16_t* next, const char16_t* end, const char16_t*& resume);
    void flush();
    [[noreturn]] void fail(const QString& what, int err);

    struct ConverterClose {
        void operator()(UConverter* c) const;
    };

    QString path_;
    std::FILE* file_ = nullptr;
    std::unique_ptr<UConverter, ConverterClose> converter_;
    // Encoded bytes not yet in the file: buffer_[0 .. used_).
    std::unique_ptr<char[]> buffer_;
    std::size_t used_ = 0;
    // A high surrogate at the end of a piece waits for its other half, which
    // may start the next piece.
    char16_t heldLead_ = 0;
};

} // namespace ardcard
