#pragma once

#include <QString>
#include <exception>
#include <string>

namespace ardcard {

// The one error type of the system. Whatever fails (a driver, a file, a
// conversion) is thrown as a Failure carrying a description fit to show the
// user; the one place that shows it (a message box of the card, the dialog or
// an information page) reads description().
class Failure : public std::exception {
public:
    explicit Failure(QString description, int number = 0)
        : description_(std::move(description)), number_(number),
          utf8_(description_.toUtf8().toStdString()) {}

    const QString& description() const noexcept { return description_; }
    // The driver's native error number where there is one, else 0.
    int number() const noexcept { return number_; }
    const char* what() const noexcept override { return utf8_.c_str(); }

private:
    QString description_;
    int number_;
    std::string utf8_;
};

} // namespace ardcard
