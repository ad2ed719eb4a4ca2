#pragma once

#include <QString>
#include <QVariant>

namespace ardcard {

// The connection string for one of the six connection types, built from the
// values exactly as they stand: nothing is quoted, escaped or trimmed.
// 1 SQL Server through ODBC, 2 SQL Server through OLE DB (integrated security
// when uid is empty), 3/4 an Access file through Jet 3.51/4.0, 5 an ODBC data
// source name (the database), 6 an Access file through the Access ODBC
// driver. Any other type gives an empty text. A Null pwd counts as empty.
QString BuildConnString(const QString& server, const QString& uid, const QVariant& pwd,
                        const QString& database, int connType);

} // namespace ardcard
