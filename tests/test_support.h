#pragma once

// Helpers every card-level test program shares: company files built with the
// host product's schema, an isolated settings and temporary directory, the
// clerk's hands on a card's controls, and the checks the fault and hostile
// suites make around every command (company files unchanged, no file left
// open, no message that shows the password).

#include "card/card.h"
#include "common/failure.h"
#include "demo/company_writer.h"
#include "host/message_box.h"

#include <QByteArray>
#include <QCryptographicHash>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSqlDatabase>
#include <QSqlQuery>
#include <QSqlRecord>
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

inline void resetSettings(const QTemporaryDir& dir) {
    const QString ini = settingsFile(dir);
    QDir(ini).removeRecursively();
    QFile::remove(ini);
}

inline QByteArray readFile(const QString& path) {
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

inline bool writeFile(const QString& path, const QByteArray& bytes) {
    QFile file(path);
    return file.open(QIODevice::WriteOnly | QIODevice::Truncate) &&
           file.write(bytes) == bytes.size();
}

// A card's control by object name; a missing one ends the test program,
// since every later step would test nothing.
template <typename T> T* child(const QWidget& parent, const QString& name) {
    auto* widget = parent.findChild<T*>(name);
    if (!widget)
        qFatal("no control %s", qPrintable(name));
    return widget;
}
inline QLineEdit* box(const QWidget& card, const QString& name) {
    return child<QLineEdit>(card, name);
}
inline void click(const QWidget& card, const QString& button) {
    QTest::mouseClick(child<QPushButton>(card, button), Qt::LeftButton);
}
inline void doubleClick(const QWidget& card, const QString& label) {
    QTest::mouseDClick(child<QLabel>(card, label), Qt::LeftButton);
}

// A card shown on the offscreen platform, reading the company directories
// `dirs` through the connection values already in force.
inline std::unique_ptr<ardcard::Card> shownCard(const QString& dirs) {
    auto card = std::make_unique<ardcard::Card>();
    card->setCompDir(dirs);
    card->resize(900, 640);
    card->show();
    if (!QTest::qWaitForWindowExposed(card.get()))
        qWarning("card not exposed");
    return card;
}

} // namespace fixture

namespace hostile {

// A password no message may ever show.
inline const QString kPassword = QStringLiteral("Pw-7731-Zq!secret");

// Open descriptors of this process that point into `dir`.
inline QStringList openFilesUnder(const QString& dir) {
    QStringList under;
    const QString prefix = QDir(dir).canonicalPath();
    const QDir fds(QStringLiteral("/proc/self/fd"));
    for (const QString& name : fds.entryList(QDir::Files | QDir::System | QDir::NoDotAndDotDot)) {
        const QString target = QFileInfo(fds.filePath(name)).symLinkTarget();
        if (!prefix.isEmpty() && target.startsWith(prefix))
            under << target;
    }
    return under;
}

// The file's bytes and every row of every table, in rowid order, each value
// with its type: the database exactly as it stands.
inline QByteArray fingerprint(const QString& path) {
    QCryptographicHash hash(QCryptographicHash::Sha256);
    hash.addData(fixture::readFile(path));
    const QString name = QStringLiteral("fingerprint-") + path;
    {
        QSqlDatabase db = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), name);
        db.setDatabaseName(path);
        db.setConnectOptions(QStringLiteral("QSQLITE_OPEN_READONLY"));
        if (!db.open())
            return "not a database";
        QSqlQuery tables(db);
        tables.exec(QStringLiteral(
            "SELECT name, sql FROM sqlite_master WHERE type = 'table' ORDER BY name"));
        QStringList names;
        while (tables.next()) {
            names << tables.value(0).toString();
            hash.addData(tables.value(1).toString().toUtf8());
        }
        for (const QString& table : names) {
            QSqlQuery rows(db);
            rows.exec(QStringLiteral("SELECT * FROM \"%1\" ORDER BY rowid").arg(table));
            const int columns = rows.record().count();
            while (rows.next()) {
                for (int c = 0; c < columns; ++c) {
                    const QVariant v = rows.value(c);
                    hash.addData(QByteArray::number(v.isNull() ? -1 : v.typeId()));
                    hash.addData(v.toString().toUtf8());
                    hash.addData("\x1f");
                }
                hash.addData("\x1e");
            }
        }
        db.close();
    }
    QSqlDatabase::removeDatabase(name);
    return hash.result().toHex();
}

// Messages that show the password, as "title: text" lines.
inline QStringList leakingMessages(const QList<ardcard::host::Message>& messages) {
    QStringList leaks;
    for (const ardcard::host::Message& m : messages) {
        if (m.text.contains(kPassword) || m.title.contains(kPassword))
            leaks << m.title + QStringLiteral(": ") + m.text;
    }
    return leaks;
}

} // namespace hostile
