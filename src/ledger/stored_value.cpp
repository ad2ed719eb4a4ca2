#include "ledger/stored_value.h"

#include <limits>

namespace ardcard {

StoredValue::StoredValue(const QVariant& value) {
    if (value.isNull())
        return;
    switch (value.typeId()) {
    case QMetaType::Int:
        integer_ = *static_cast<const int*>(value.constData());
        kind_ = Kind::Integer;
        return;
    case QMetaType::UInt:
        integer_ = *static_cast<const uint*>(value.constData());
        kind_ = Kind::Integer;
        return;
    case QMetaType::LongLong:
        integer_ = *static_cast<const qlonglong*>(value.constData());
        kind_ = Kind::Integer;
        return;
    case QMetaType::ULongLong: {
        const qulonglong n = *static_cast<const qulonglong*>(value.constData());
        if (n <= static_cast<qulonglong>(std::numeric_limits<qlonglong>::max())) {
            integer_ = static_cast<qlonglong>(n);
            kind_ = Kind::Integer;
            return;
        }
        break;
    }
    default:
        break;
    }
    other_ = new QVariant(value);
    kind_ = Kind::Other;
}

StoredValue::StoredValue(const StoredValue& other) : kind_(other.kind_) {
    if (kind_ == Kind::Other)
        other_ = new QVariant(*other.other_);
    else if (kind_ == Kind::Integer)
        integer_ = other.integer_;
}

StoredValue& StoredValue::operator=(const StoredValue& other) {
    if (this != &other)
        *this = StoredValue(other);
    return *this;
}

StoredValue& StoredValue::operator=(StoredValue&& other) noexcept {
    if (this != &other) {
        release();
        kind_ = other.kind_;
        take(other);
    }
    return *this;
}

QString StoredValue::toString() const {
    switch (kind_) {
    case Kind::Integer:
        return QString::number(integer_);
    case Kind::Other:
        return other_->toString();
    case Kind::Null:
        break;
    }
    return {};
}

double StoredValue::sortNumber() const {
    if (kind_ == Kind::Integer)
        return static_cast<double>(integer_);
    if (kind_ == Kind::Null)
        return 0.0;
    bool ok = false;
    const double number = other_->toDouble(&ok);
    if (ok)
        return number;
    const double parsed = other_->toString().trimmed().toDouble(&ok);
    return ok ? parsed : 0.0;
}

} // namespace ardcard
