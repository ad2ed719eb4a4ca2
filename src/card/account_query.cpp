#include "card/account_query.h"

namespace ardcard {

QString TrimBlanks(const QString& value) {
    qsizetype begin = 0;
    qsizetype end = value.size();
    while (begin < end && value.at(begin) == u' ')
        ++begin;
    while (end > begin && value.at(end - 1) == u' ')
        --end;
    return value.mid(begin, end - begin);
}

QString SqlText(const QString& value) {
    QString escaped = value;
    escaped.replace(u'\'', QStringLiteral("''"));
    return u'\'' + escaped + u'\'';
}

QString SearchCondition(const QString& searchBy, const QString& value) {
    const auto is = [&](const char16_t* kind) {
        return searchBy.compare(QString::fromUtf16(kind), Qt::CaseInsensitive) == 0;
    };
    const auto like = [&](const QString& column) {
        return column + QStringLiteral(" Like ") + SqlText(u'%' + value + u'%');
    };
    if (is(u"AccountKey"))
        return QStringLiteral("AccountKey = ") + SqlText(value);
    if (is(u"AccountName"))
        return like(QStringLiteral("FullName"));
    if (is(u"Telephone"))
        return like(QStringLiteral("Phone"));
    if (is(u"Address"))
        return like(QStringLiteral("Address"));
    if (is(u"Details"))
        return like(QStringLiteral("Details"));
    return {};
}

QString ChoosingQuery(const QString& startFrom, int location, const QString& searchBy,
                      const QString& searchValue) {
    const auto is = [&](const char16_t* kind) {
        return startFrom.compare(QString::fromUtf16(kind), Qt::CaseInsensitive) == 0;
    };
    QString aggregate;
    QString position;
    if (is(u"First")) {
        aggregate = QStringLiteral("Min(ID)");
    } else if (is(u"Last")) {
        aggregate = QStringLiteral("Max(ID)");
    } else if (is(u"Next")) {
        aggregate = QStringLiteral("Min(ID)");
        position = QStringLiteral("ID > %1").arg(location);
    } else if (is(u"Previous")) {
        aggregate = QStringLiteral("Max(ID)");
        position = QStringLiteral("ID < %1").arg(location);
    }

    QString sql = QStringLiteral("SELECT ") + aggregate +
                  QStringLiteral(" As StartID FROM Accounts WHERE Dumi = 0");
    if (!position.isEmpty())
        sql += QStringLiteral(" And ") + position;
    const QString condition = SearchCondition(searchBy, searchValue);
    if (!condition.isEmpty())
        sql += QStringLiteral(" And ") + condition;
    return sql;
}

QString AccountRowQuery(int id) {
    return QStringLiteral("SELECT AccountKey, FullName, Phone, Filter, Obligo, Balance, Address, "
                          "Details, City, Zip, Delivery, Country, Agent FROM Accounts "
                          "WHERE ID = %1")
        .arg(id);
}

} // namespace ardcard
