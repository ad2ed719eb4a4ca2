#include "ledger/stored_value.h"

#include <limits>

namespace ardcard {

StoredValue::StoredValue(const QVariant& value) {
    if (value.isNull())
        return;
    switch (value.typeId()) {
    case QMetaType::Int:
    case QMetaType::UInt:
    case QMetaType::LongLong:
        value_ = value.toLongLong();
        return;
    case QMetaType::ULongLong:
        if (value.toULongLong() <= static_cast<qulonglong>(std::numeric_limits<qlonglong>::max())) {
            value_ = value.toLongLong();
            return;
        }
        break;
    default:
        break;
    }
    value_ = std::make_unique<QVariant>(value);
}

StoredValue::StoredValue(const StoredValue& other) {
    *this = other;
}

StoredValue& StoredValue::operator=(const StoredValue& other) {
    if (const auto* held = std::get_if<std::unique_ptr<QVariant>>(&other.value_))
        value_ = std::make_unique<QVariant>(**held);
    else if (other.isInteger())
        value_ = other.integer();
    else
        value_ = std::monostate();
    return *this;
}

QString StoredValue::toString() const {
    if (isInteger())
        return QString::number(integer());
    if (const auto* held = std::get_if<std::unique_ptr<QVariant>>(&value_))
        return (*held)->toString();
    return {};
}

double StoredValue::sortNumber() const {
    if (isInteger())
        return static_cast<double>(integer());
    const auto* held = std::get_if<std::unique_ptr<QVariant>>(&value_);
    if (!held)
        return 0.0;
    bool ok = false;
    const double number = (*held)->toDouble(&ok);
    if (ok)
        return number;
    const double parsed = (*held)->toString().trimmed().toDouble(&ok);
    return ok ? parsed : 0.0;
}

} // namespace ardcard
