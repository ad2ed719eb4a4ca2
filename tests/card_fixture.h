#pragma once

// Company database files for the card and dialog tests, written with plain
// SQLite SQL: the tables and columns the card reads, nothing more.

#include <QDir>
#include <QFile>
#include <QSettings>
#include <QSqlDatabase>
#include <QSqlError>
#include <QSqlQuery>
#include <QString>
#include <QStringList>
#include <QTemporaryDir>
#include <QTest>

namespace fixture {

inline const QString kAccountsTable = QStringLiteral(
    "CREATE TABLE Accounts (ID INTEGER PRIMARY KEY, AccountKey TEXT COLLATE NOCASE,"
    " FullName TEXT, Phone TEXT, Address TEXT, Details TEXT, Filter TEXT COLLATE NOCASE,"
    " Balance DOUBLE PRECISION, Obligo DOUBLE PRECISION, Delivery DOUBLE PRECISION,"
    " City TEXT, Zip TEXT, Country TEXT, Agent INTEGER, Dumi INTEGER DEFAULT 0)");

inline const QString kCompanyTable =
    QStringLiteral("CREATE TABLE CompanyDefenitions (ID INTEGER PRIMARY KEY, CompanyName TEXT,"
                   " ShortName TEXT, VatNum TEXT, DeductNum TEXT,"
                   " HiddenAccountsFilter TEXT COLLATE NOCASE)");

// Creates (or replaces) dir/file and runs the statements in it.
inline bool createDatabase(const QString& dir, const QString& file, const QStringList& sql) {
    const QString path = QDir(dir).filePath(file);
    QFile::remove(path);
    const QString name = QStringLiteral("fixture-") + file;
    bool ok = true;
    {
        QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), name);
        db.setDatabaseName(path);
        ok = db.open();
        QSqlQuery query(db);
        for (const QString& statement : sql) {
            if (!query.exec(statement)) {
                qWarning("%s: %s", qPrintable(statement), qPrintable(query.lastError().text()));
                ok = false;
            }
        }
        db.close();
    }
    QSqlDatabase::removeDatabase(name);
    return ok;
}

// Points XDG_CONFIG_HOME, TMPDIR and Temp at `dir` before anything reads
// them, so that settings and output files stay inside the test's directory.
inline void isolate(const QTemporaryDir& dir) {
    qputenv("XDG_CONFIG_HOME", dir.path().toUtf8());
    qputenv("TMPDIR", dir.path().toUtf8());
    qputenv("Temp", dir.path().toUtf8());
}

// The settings file of application "VL7Trans".
inline QString settingsFile(const QTemporaryDir& dir) {
    return QDir(dir.path()).filePath(QStringLiteral("VL7Trans.ini"));
}

// Empties the settings store. QSettings keeps a parsed copy of the file in
// the process, so the store is cleared through it before the file goes.
inline void resetSettings(const QTemporaryDir& dir) {
    const QString ini = settingsFile(dir);
    QDir(ini).removeRecursively();
    {
        QSettings settings(QSettings::IniFormat, QSettings::UserScope, QStringLiteral("VL7Trans"));
        settings.clear();
        settings.sync();
    }
    QFile::remove(ini);
}

} // namespace fixture
