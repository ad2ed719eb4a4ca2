#pragma once

#include <QString>
#include <QStringView>
#include <cstdio>
#include <memory>
#include <string>

struct UConverter;

namespace ardcard {

// Writes one output file in the windows-1255 code page, every line ended by
// CR LF; a line may be written in pieces. Opening deletes a file of the same
// name first. The file is closed by close() or, on any failure path, by the
// destructor, which keeps what was written so far; so no error leaves a file
// open. Failures throw Failure.
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

    void write(QStringView piece);
    void endLine();
    void writeLine(QStringView line) {
        write(line);
        endLine();
    }
    // Flushes and closes; throws when the data did not reach the file.
    void close();

    const QString& path() const { return path_; }

private:
    void flushPending(bool last);
    [[noreturn]] void fail(const QString& what, int err);

    QString path_;
    std::FILE* file_ = nullptr;
    struct ConverterClose {
        void operator()(UConverter* c) const;
    };
    std::unique_ptr<UConverter, ConverterClose> converter_;
    std::u16string pending_;
    std::string encoded_;
};

} // namespace ardcard
