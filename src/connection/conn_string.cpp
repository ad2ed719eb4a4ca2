#include "connection/conn_string.h"

namespace ardcard {

namespace {
// The server directory and the database file name, one backslash between.
QString filePath(const QString& server, const QString& database) {
    if (server.isEmpty())
        return database;
    if (server.endsWith(u'\\'))
        return server + database;
    return server + u'\\' + database;
}
} // namespace

QString BuildConnString(const QString& server, const QString& uid, const QVariant& pwd,
                        const QString& database, int connType) {
    const QString p = pwd.isNull() ? QString() : pwd.toString();
    switch (connType) {
    case 1:
        return QStringLiteral("driver={SQL Server};server=") + server + QStringLiteral(";uid=") +
               uid + QStringLiteral(";pwd=") + p + QStringLiteral(";database=") + database;
    case 2:
        if (uid.isEmpty())
            return QStringLiteral("Provider=sqloledb;Data Source=") + server +
                   QStringLiteral(";Integrated Security=SSPI;Persist Security Info=False"
                                  ";Initial Catalog=") +
                   database;
        return QStringLiteral("Provider=sqloledb;Data Source=") + server +
               QStringLiteral(";User Id=") + uid + QStringLiteral(";Password=") + p +
               QStringLiteral(";Initial Catalog=") + database;
    case 3:
        return QStringLiteral("Provider=Microsoft.Jet.OLEDB.3.51;Data Source=") +
               filePath(server, database);
    case 4:
        return QStringLiteral("Provider=Microsoft.Jet.OLEDB.4.0;Data Source=") +
               filePath(server, database);
    case 5:
        return QStringLiteral("DSN=") + database + QStringLiteral(";uid=") + uid +
               QStringLiteral(";pwd=") + p;
    case 6:
        return QStringLiteral("driver={Microsoft Access Driver (*.mdb)};Dbq=") +
               filePath(server, database) + QStringLiteral(";uid=") + uid +
               QStringLiteral(";pwd=") + p;
    default:
        return {};
    }
}

} // namespace ardcard
