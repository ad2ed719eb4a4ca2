#pragma once

#include <QString>

namespace ardcard {

// How a connection string of the six kinds is opened on this platform.
//  - "driver=..." and "DSN=..." ODBC strings go to QODBC unchanged;
//  - a Jet OLE DB string or the Access ODBC string names a local file: an
//    SQLite database file is opened with QSQLITE read-only, any other file
//    through the Access ODBC driver;
//  - the SQL Server OLE DB string becomes the equivalent ODBC SQL Server string.
// A backslash in a file path is a directory separator here.
struct DriverTarget {
    QString driver;       // "QSQLITE" or "QODBC"
    QString databaseName; // file path or ODBC connection string
    QString options;      // QSqlDatabase connect options
};

// Throws Failure for an empty or unknown string. `timeoutSeconds` is the
// login time-out handed to the driver.
DriverTarget MapConnString(const QString& connStr, int timeoutSeconds);

// True when the file starts with the SQLite header.
bool IsSqliteFile(const QString& path);

} // namespace ardcard
