#pragma once

#include "common/formats.h"

#include <QString>
#include <QVariant>
#include <cstddef>
#include <memory>
#include <variant>

namespace ardcard {

// A database value kept as the database gave it, in 16 bytes: a whole
// number (every usual batch or transaction number) as itself, Null as
// nothing, and anything else (text, a fraction, an unsigned number beyond
// 64-bit signed) as its QVariant held aside. Its text and number are the
// QVariant's own, so keeping it this way changes nothing the grid shows.
class StoredValue {
public:
    // Implicit, so that a row is filled by assigning what was read.
    StoredValue() = default;
    StoredValue(const QVariant& value);
    StoredValue(qlonglong value) : value_(value) {}
    StoredValue(int value) : value_(qlonglong{value}) {}
    StoredValue(unsigned value) : value_(qlonglong{value}) {}
    StoredValue(double value) : StoredValue(QVariant(value)) {}
    StoredValue(const QString& value) : StoredValue(QVariant(value)) {}
    StoredValue(const StoredValue& other);
    StoredValue(StoredValue&&) noexcept = default;
    StoredValue& operator=(const StoredValue& other);
    StoredValue& operator=(StoredValue&&) noexcept = default;
    ~StoredValue() = default;

    bool isInteger() const { return std::holds_alternative<qlonglong>(value_); }
    qlonglong integer() const { return isInteger() ? std::get<qlonglong>(value_) : 0; }
    QString toString() const;
    // The value as a number, the way a numeric sort of the grid reads its
    // text: a number as itself, text that is not a number as 0.
    double sortNumber() const;

private:
    std::variant<std::monostate, qlonglong, std::unique_ptr<QVariant>> value_;
};

static_assert(sizeof(StoredValue) == 16);

// The text of a whole number into `out`, as toString() gives it; 0 for any
// other value, whose text the caller takes from toString().
inline std::size_t FormatStoredIntegerTo(char* out, const StoredValue& value) {
    return value.isInteger() ? FormatIntegerTo(out, value.integer()) : 0;
}

} // namespace ardcard
