#include "common/text_helpers.h"

#include "common/decimal_digits.h"

#include <QDateTime>
#include <QDir>
#include <optional>

namespace ardcard {

QString StripQuotes(const QVariant& value) {
    if (value.isNull())
        return {};
    const QString text = value.toString();
    QString out;
    out.reserve(text.size());
    for (const QChar c : text) {
        if (c != u'"' && c != u'\'' && c != u',')
            out += c;
    }
    return out;
}

int SplitCompanyDirs(const QString& text, QStringList& list) {
    QStringList entries{QString()};
    QString token;
    for (const QChar c : text) {
        if (c != u';' && c != u',') {
            token += c;
        } else if (!token.isEmpty()) {
            entries.append(token);
            token.clear();
        }
    }
    if (!token.isEmpty())
        entries.append(token);
    const int count = static_cast<int>(entries.size()) - 1;
    if (count > 0)
        list = std::move(entries);
    return count;
}

QString NullToText(const QVariant& value, const QString& fallback) {
    return value.isNull() ? fallback : PlainText(value);
}

double NullToZero(const QVariant& value) {
    if (value.isNull())
        return 0.0;
    bool ok = false;
    const double d = value.toDouble(&ok);
    return ok ? d : 0.0;
}

QString NullToNbsp(const QVariant& value) {
    return value.isNull() ? QStringLiteral("&nbsp;") : PlainText(value);
}

QString PlainNumber(double value) {
    const detail::SignificantDigits d = detail::ToSignificantDigits(value);
    if (d.digits == 0)
        return QStringLiteral("0");
    std::string digits = std::to_string(d.digits); // 15 digits
    // digits x 10^exponent with the point after the first digit: e is the
    // power of ten of that first digit.
    const int e = d.exponent + 14;
    digits.resize(digits.find_last_not_of('0') + 1);

    std::string out;
    if (d.negative)
        out += '-';
    const auto len = static_cast<int>(digits.size());
    if (e < 0) {
        out += "0.";
        out.append(static_cast<size_t>(-e) - 1, '0');
        out += digits;
    } else if (e >= len - 1) {
        out += digits;
        out.append(static_cast<size_t>(e) - (digits.size() - 1), '0');
    } else {
        const auto point = static_cast<size_t>(e) + 1;
        out.append(digits, 0, point);
        out += '.';
        out.append(digits, point, std::string::npos);
    }
    return QString::fromLatin1(out.data(), static_cast<qsizetype>(out.size()));
}

QString PlainText(const QVariant& value) {
    if (value.isNull())
        return {};
    switch (value.typeId()) {
    case QMetaType::Double:
    case QMetaType::Float:
        return PlainNumber(value.toDouble());
    case QMetaType::QDate:
        return value.toDate().toString(Qt::ISODate);
    case QMetaType::QDateTime: {
        const QDateTime dt = value.toDateTime();
        return dt.time() == QTime(0, 0) ? dt.date().toString(Qt::ISODate)
                                        : dt.toString(QStringLiteral("yyyy-MM-dd HH:mm:ss"));
    }
    case QMetaType::Bool:
        return value.toBool() ? QStringLiteral("1") : QStringLiteral("0");
    default:
        return value.toString();
    }
}

namespace {
// "yyyy-mm-dd" at the start of the text followed by nothing, a space or "T":
// the usual shape of a stored date, read without building temporary strings
// (a ledger reads two per line). Anything else goes the general way.
std::optional<QDate> quickIsoDate(QStringView text) {
    if (text.size() < 10 || (text.size() > 10 && text[10] != u' ' && text[10] != u'T'))
        return std::nullopt;
    int parts[3] = {0, 0, 0};
    int part = 0;
    for (qsizetype i = 0; i < 10; ++i) {
        const char16_t c = text[i].unicode();
        if (i == 4 || i == 7) {
            if (c != u'-')
                return std::nullopt;
            ++part;
        } else if (c >= u'0' && c <= u'9') {
            parts[part] = parts[part] * 10 + (c - u'0');
        } else {
            return std::nullopt;
        }
    }
    return QDate(parts[0], parts[1], parts[2]);
}
} // namespace

QDate ToDate(const QVariant& value) {
    if (value.isNull())
        return {};
    switch (value.typeId()) {
    case QMetaType::QDate:
        return value.toDate();
    case QMetaType::QDateTime:
        return value.toDateTime().date();
    case QMetaType::QString: {
        if (const auto quick = quickIsoDate(*static_cast<const QString*>(value.constData())))
            return *quick;
        const QString text = value.toString().trimmed();
        if (text.size() < 10)
            return {};
        const QDate date = QDate::fromString(text.left(10), Qt::ISODate);
        if (!date.isValid() || (text.size() > 10 && text[10] != u' ' && text[10] != u'T'))
            return {};
        return date;
    }
    default:
        return {};
    }
}

QString TempDirectory() {
    const QString set = qEnvironmentVariable("TMPDIR");
    if (!set.isEmpty())
        return QDir::cleanPath(set);
    return QDir::tempPath();
}

} // namespace ardcard
