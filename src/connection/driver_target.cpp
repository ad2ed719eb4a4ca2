#include "connection/driver_target.h"

#include "common/failure.h"

#include <QFile>
#include <QFileInfo>
#include <QList>
#include <QPair>

namespace ardcard {

namespace {

using Pairs = QList<QPair<QString, QString>>;

// "a=b;c=d" into its name/value pairs, names as written.
Pairs splitPairs(const QString& connStr) {
    Pairs out;
    for (const QString& part : connStr.split(u';')) {
        const qsizetype eq = part.indexOf(u'=');
        if (eq < 0)
            out.append({part.trimmed(), QString()});
        else
            out.append({part.left(eq).trimmed(), part.mid(eq + 1)});
    }
    return out;
}

QString pairValue(const Pairs& pairs, const QString& name) {
    for (const auto& [k, v] : pairs) {
        if (k.compare(name, Qt::CaseInsensitive) == 0)
            return v;
    }
    return {};
}

bool startsWithKey(const QString& connStr, const QString& key) {
    return connStr.trimmed().startsWith(key, Qt::CaseInsensitive);
}

QString odbcOptions(int timeoutSeconds) {
    return QStringLiteral("SQL_ATTR_LOGIN_TIMEOUT=%1;SQL_ATTR_CONNECTION_TIMEOUT=%1")
        .arg(timeoutSeconds);
}

QString localPath(QString path) {
    return path.replace(u'\\', u'/');
}

// A local database file: SQLite read-only when it is one, else the Access
// ODBC driver with the file.
DriverTarget fileTarget(const QString& windowsPath, const QString& odbcString, int timeoutSeconds) {
    const QString path = localPath(windowsPath);
    if (!QFileInfo::exists(path))
        throw Failure(QStringLiteral("קובץ בסיס הנתונים %1 לא נמצא").arg(path));
    if (IsSqliteFile(path))
        return {QStringLiteral("QSQLITE"), path,
                QStringLiteral("QSQLITE_OPEN_READONLY;QSQLITE_BUSY_TIMEOUT=%1")
                    .arg(timeoutSeconds * 1000)};
    return {QStringLiteral("QODBC"), odbcString, odbcOptions(timeoutSeconds)};
}

} // namespace

bool IsSqliteFile(const QString& path) {
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly))
        return false;
    return file.read(16) == QByteArray("SQLite format 3\0", 16);
}

DriverTarget MapConnString(const QString& connStr, int timeoutSeconds) {
    if (connStr.trimmed().isEmpty())
        throw Failure(QStringLiteral("לא הוגדר סוג בסיס נתונים: מחרוזת ההתחברות ריקה"));

    const Pairs pairs = splitPairs(connStr);
    if (startsWithKey(connStr, QStringLiteral("Provider="))) {
        const QString provider = pairValue(pairs, QStringLiteral("Provider"));
        if (provider.startsWith(QStringLiteral("Microsoft.Jet.OLEDB"), Qt::CaseInsensitive)) {
            const QString file = pairValue(pairs, QStringLiteral("Data Source"));
            const QString odbc =
                QStringLiteral("driver={Microsoft Access Driver (*.mdb)};Dbq=") + file;
            return fileTarget(file, odbc, timeoutSeconds);
        }
        if (provider.compare(QStringLiteral("sqloledb"), Qt::CaseInsensitive) == 0) {
            QString odbc = QStringLiteral("driver={SQL Server};server=") +
                           pairValue(pairs, QStringLiteral("Data Source"));
            if (pairValue(pairs, QStringLiteral("Integrated Security")).isEmpty())
                odbc += QStringLiteral(";uid=") + pairValue(pairs, QStringLiteral("User Id")) +
                        QStringLiteral(";pwd=") + pairValue(pairs, QStringLiteral("Password"));
            else
                odbc += QStringLiteral(";Trusted_Connection=yes");
            odbc +=
                QStringLiteral(";database=") + pairValue(pairs, QStringLiteral("Initial Catalog"));
            return {QStringLiteral("QODBC"), odbc, odbcOptions(timeoutSeconds)};
        }
        throw Failure(QStringLiteral("ספק הנתונים %1 אינו נתמך").arg(provider));
    }
    if (startsWithKey(connStr, QStringLiteral("driver="))) {
        const QString driver = pairValue(pairs, QStringLiteral("driver"));
        if (driver.contains(QStringLiteral("Microsoft Access Driver"), Qt::CaseInsensitive))
            return fileTarget(pairValue(pairs, QStringLiteral("Dbq")), connStr, timeoutSeconds);
        return {QStringLiteral("QODBC"), connStr, odbcOptions(timeoutSeconds)};
    }
    if (startsWithKey(connStr, QStringLiteral("DSN=")))
        return {QStringLiteral("QODBC"), connStr, odbcOptions(timeoutSeconds)};
    throw Failure(QStringLiteral("מחרוזת התחברות לא מוכרת"));
}

} // namespace ardcard
