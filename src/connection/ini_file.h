#pragma once

#include <QString>
#include <optional>

namespace ardcard {

// The settings file in the plain INI form that people and other programs
// write by hand: "[Section]" lines and "Key=Value" lines, values taken as the
// rest of the line. Qt's own INI dialect is not used on purpose: it reads
// ";" as the start of a comment and "," as a list separator, so a
// hand-written company-directory text "demo.db;demo2.db" would be cut, and
// saving one key would rewrite the others as it had misread them.
class IniFile {
public:
    explicit IniFile(QString path) : path_(std::move(path)) {}

    // The value, or nothing when the key is missing or the file cannot be
    // read. Section and key names compare without regard to case. A value
    // written in double quotes is unquoted (\" and \\ inside).
    std::optional<QString> read(const QString& section, const QString& key) const;

    // Sets one value, keeping every other line as it was; creates the file
    // (owner read/write only) and the section as needed. Throws Failure.
    void write(const QString& section, const QString& key, const QString& value) const;

    const QString& path() const { return path_; }

private:
    QString path_;
};

} // namespace ardcard
