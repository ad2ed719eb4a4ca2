#include "common/formats.h"

#include "common/decimal_digits.h"

#include <cmath>

namespace ardcard {

namespace {

// |value| x 10^decimals rounded half away from zero, as digits, when plain
// double arithmetic gives the same digits as rounding the 15-digit decimal
// form: small enough magnitudes whose scaled fraction is not near a half.
// A grid of a million rows formats three amounts per row, so this matters.
bool quickRoundedScaled(double value, int decimals, std::string& out) {
    static constexpr double kScale[] = {1.0, 10.0, 100.0, 1000.0};
    if (decimals < 0 || decimals > 3)
        return false;
    const double scaled = std::fabs(value) * kScale[decimals];
    if (!(scaled < 1e11))
        return false;
    const double whole = std::floor(scaled);
    const double fraction = scaled - whole;
    if (std::fabs(fraction - 0.5) < 1e-3)
        return false;
    auto n = static_cast<long long>(whole) + (fraction > 0.5 ? 1 : 0);
    char buf[24];
    char* p = buf + sizeof buf;
    do {
        *--p = static_cast<char>('0' + n % 10);
        n /= 10;
    } while (n > 0);
    out.assign(p, buf + sizeof buf);
    return true;
}

} // namespace

QString FormatGrouped(double value, int decimals, bool emptyWhenZero) {
    std::string n;
    bool negative = value < 0;
    if (!quickRoundedScaled(value, decimals, n)) {
        const detail::DecimalDigits d = detail::toDecimalDigits(value);
        n = detail::roundedScaled(d, decimals);
        negative = d.negative;
    }
    const bool zero = n == "0";
    if (zero && emptyWhenZero)
        return {};
    if (n.size() < static_cast<size_t>(decimals) + 1)
        n.insert(0, static_cast<size_t>(decimals) + 1 - n.size(), '0');
    const size_t intLen = n.size() - static_cast<size_t>(decimals);

    std::string out;
    out.reserve(n.size() + n.size() / 3 + 2);
    if (negative && !zero)
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

namespace {
// "dd/mm/yy" or "dd/mm/yyyy" for years 1000 to 9999 without the locale
// machinery of QDate::toString, which costs more than the rest of a grid row.
QString quickDate(QDate date, bool longYear) {
    const int y = date.year();
    const int d = date.day();
    const int m = date.month();
    char16_t buf[10] = {char16_t(u'0' + d / 10), char16_t(u'0' + d % 10), u'/',
                        char16_t(u'0' + m / 10), char16_t(u'0' + m % 10), u'/'};
    qsizetype len = 6;
    if (longYear) {
        buf[len++] = char16_t(u'0' + y / 1000);
        buf[len++] = char16_t(u'0' + y / 100 % 10);
    }
    buf[len++] = char16_t(u'0' + y / 10 % 10);
    buf[len++] = char16_t(u'0' + y % 10);
    return QString(reinterpret_cast<const QChar*>(buf), len);
}
bool quickYear(QDate date) {
    return date.isValid() && date.year() >= 1000 && date.year() <= 9999;
}
} // namespace

QString FormatShortDate(QDate date) {
    if (quickYear(date))
        return quickDate(date, false);
    return date.toString(QStringLiteral("dd/MM/yy"));
}
QString FormatLongDate(QDate date) {
    if (quickYear(date))
        return quickDate(date, true);
    return date.toString(QStringLiteral("dd/MM/yyyy"));
}

} // namespace ardcard
