#include "common/formats.h"

#include "common/decimal_digits.h"

namespace ardcard {

QString FormatGrouped(double value, int decimals, bool emptyWhenZero) {
    const detail::DecimalDigits d = detail::toDecimalDigits(value);
    std::string n = detail::roundedScaled(d, decimals);
    const bool zero = n == "0";
    if (zero && emptyWhenZero)
        return {};
    if (n.size() < static_cast<size_t>(decimals) + 1)
        n.insert(0, static_cast<size_t>(decimals) + 1 - n.size(), '0');
    const size_t intLen = n.size() - static_cast<size_t>(decimals);

    std::string out;
    out.reserve(n.size() + n.size() / 3 + 2);
    if (d.negative && !zero)
        out += '-';
    for (size_t i = 0; i < intLen; ++i) {
        if (i > 0 && (intLen - i) % 3 == 0)
            out += ',';
        out += n[i];
    }
    if (decimals > 0) {
        out += '.';
        out.append(n, intLen, std::string::npos);
    }
    return QString::fromLatin1(out.data(), static_cast<qsizetype>(out.size()));
}

QString FormatMoney(double value) {
    return FormatGrouped(value, 2);
}
QString FormatQuantity(double value) {
    return FormatGrouped(value, 3);
}
QString FormatWhole(double value) {
    return FormatGrouped(value, 0, true);
}

QString FormatShortDate(QDate date) {
    return date.toString(QStringLiteral("dd/MM/yy"));
}
QString FormatLongDate(QDate date) {
    return date.toString(QStringLiteral("dd/MM/yyyy"));
}

} // namespace ardcard
