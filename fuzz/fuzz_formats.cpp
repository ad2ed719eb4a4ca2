// Number and date formats on any double and any day.
#include "common/formats.h"
#include "common/text_helpers.h"

#include <QRegularExpression>
#include <cmath>
#include <cstdlib>
#include <cstring>

using namespace ardcard;

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    if (size < sizeof(double))
        return 0;
    double value;
    std::memcpy(&value, data, sizeof value);

    static const QRegularExpression money(QStringLiteral("^-?\\d{1,3}(,\\d{3})*\\.\\d{2}$"));
    static const QRegularExpression quantity(QStringLiteral("^-?\\d{1,3}(,\\d{3})*\\.\\d{3}$"));
    static const QRegularExpression whole(QStringLiteral("^(-?\\d{1,3}(,\\d{3})*)?$"));
    if (!money.match(FormatMoney(value)).hasMatch())
        std::abort();
    if (!quantity.match(FormatQuantity(value)).hasMatch())
        std::abort();
    if (!whole.match(FormatWhole(value)).hasMatch())
        std::abort();

    const QString plain = PlainNumber(value);
    if (std::isfinite(value)) {
        bool ok = false;
        const double back = plain.toDouble(&ok);
        if (plain.contains(u'e') || plain.contains(u','))
            std::abort();
        // 15 significant digits survive; near the largest double they may
        // round past it, and the text then no longer reads back as a double
        if (ok ? std::fabs(back - value) > std::fabs(value) * 1e-14 : std::fabs(value) < 1e308)
            std::abort();
    }

    if (size >= sizeof(double) + sizeof(qint32)) {
        qint32 day;
        std::memcpy(&day, data + sizeof(double), sizeof day);
        const QDate date = QDate::fromJulianDay(day);
        const QString shortDate = FormatShortDate(date);
        const QString longDate = FormatLongDate(date);
        if (date.isValid() && date.year() > 0 && date.year() < 10000 &&
            (shortDate.size() != 8 || longDate.size() != 10))
            std::abort();
        (void)ToDate(QVariant(QString::fromLatin1(reinterpret_cast<const char*>(data),
                                                  static_cast<qsizetype>(size))));
    }
    return 0;
}
