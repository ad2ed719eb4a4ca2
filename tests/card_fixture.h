#pragma once

// Company files for the card and dialog tests: the host product's schema
// from the fixture writer, filled with a few rows each test names.

#include "common/failure.h"
#include "demo/company_writer.h"

#include <QDir>
#include <QFile>
#include <QSettings>
#include <QString>
#include <QStringList>
#include <QTemporaryDir>
#include <QTest>

namespace fixture {

// One Accounts row from the values of the columns the card reads, in this
// order: ID, AccountKey, FullName, Phone, Address, Details, Filter, Balance,
// Obligo, Delivery, City, Zip, Country, Agent, Dumi.
inline QString accountRow(const QString& values) {
    return QStringLiteral("INSERT INTO Accounts (ID, AccountKey, FullName, Phone, Address,"
                          " Details, Filter, Balance, Obligo, Delivery, City, Zip, Country,"
                          " Agent, Dumi) VALUES (") +
           values + u')';
}

// The company definitions row: ID, CompanyName, ShortName, VatNum, DeductNum,
// HiddenAccountsFilter.
inline QString companyRow(const QString& values) {
    return QStringLiteral("INSERT INTO CompanyDefenitions (ID, CompanyName, ShortName, VatNum,"
                          " DeductNum, HiddenAccountsFilter) VALUES (") +
           values + u')';
}

// Creates (or replaces) the company file dir/file with the host product's
// schema and runs the statements in it.
inline bool createDatabase(const QString& dir, const QString& file, const QStringList& sql) {
    const QString path = QDir(dir).filePath(file);
    try {
        ardcard::demo::CreateCompanyFile(path);
        ardcard::demo::CompanyWriter writer(path);
        for (const QString& statement : sql)
            writer.exec(statement);
        writer.commit();
    } catch (const ardcard::Failure& failure) {
        qWarning("%s: %s", qPrintable(file), qPrintable(failure.description()));
        return false;
    }
    return true;
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
