#pragma once

#include "common/formats.h"

#include <QString>
#include <QVariant>
#include <cstddef>

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
    StoredValue(int value) : integer_(value), kind_(Kind::Integer) {}
    StoredValue(unsigned value) : integer_(value), kind_(Kind::Integer) {}
    StoredValue(qlonglong value) : integer_(value), kind_(Kind::Integer) {}
    StoredValue(double value) : StoredValue(QVariant(value)) {}
    StoredValue(const QString& value) : StoredValue(QVariant(value)) {}
    StoredValue(const StoredValue& other);
    StoredValue(StoredValue&& other) noexcept : kind_(other.kind_) { take(other); }
    StoredValue& operator=(const StoredValue& other);
    StoredValue& operator=(StoredValue&& other) noexcept;
    ~StoredValue() { release(); }

    bool isInteger() const { return kind_ == Kind::Integer; }
    qlonglong integer() const { return isInteger() ? integer_ : 0; }
    QString toString() const;
    // The value as a number, the way a numeric sort of the grid reads its
    // text: a number as itself, text that is not a number as 0.
    double sortNumber() const;

private:
    enum class Kind : unsigned char { Null, Integer, Other };
    // Moves other's value (kind_ already set to other's kind) and leaves it
    // Null. The union is read only through the member its kind names.
    void take(StoredValue& other) noexcept {
        if (kind_ == Kind::Other)
            other_ = other.other_;
        else
            integer_ = kind_ == Kind::Integer ? other.integer_ : 0;
        other.kind_ = Kind::Null;
        other.integer_ = 0;
    }
    void release() noexcept {
        if (kind_ == Kind::Other)
            delete other_;
        kind_ = Kind::Null;
        integer_ = 0;
    }

    union {
        qlonglong integer_ = 0;
        QVariant* other_;
    };
    Kind kind_ = Kind::Null;
};

static_assert(sizeof(StoredValue) == 16);

// The text of a whole number into `out`, as toString() gives it; 0 for any
// other value, whose text the caller takes from toString().
inline std::size_t FormatStoredIntegerTo(char* out, const StoredValue& value) {
    return value.isInteger() ? FormatIntegerTo(out, value.integer()) : 0;
}

} // namespace ardcard
