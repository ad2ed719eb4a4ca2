#pragma once

// What the fault and hostile-input tests check around every command: that the
// company files are exactly as they were, that no file was left open, and
// that no message gives the password away.

#include "host/message_box.h"

#include <QByteArray>
#include <QCryptographicHash>
#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QSqlDatabase>
#include <QSqlError>
#include <QSqlQuery>
#include <QSqlRecord>
#include <QString>
#include <QStringList>

namespace hostile {

// A password no message may ever show.
inline const QString kPassword = QStringLiteral("Pw-7731-Zq!secret");

// The file descriptors open in this process, each as the path it points to.
inline QStringList openFiles() {
    QStringList targets;
    const QDir fds(QStringLiteral("/proc/self/fd"));
    for (const QString& name : fds.entryList(QDir::Files | QDir::System | QDir::NoDotAndDotDot))
        targets << QFileInfo(fds.filePath(name)).symLinkTarget();
    return targets;
}

// Open descriptors that point into `dir`.
inline QStringList openFilesUnder(const QString& dir) {
    QStringList under;
    const QString prefix = QDir(dir).canonicalPath();
    for (const QString& target : openFiles()) {
        if (!prefix.isEmpty() && target.startsWith(prefix))
            under << target;
    }
    return under;
}

// The file's bytes and every row of every table, in rowid order, each value
// with its type: the database exactly as it stands.
inline QByteArray fingerprint(const QString& path) {
    QCryptographicHash hash(QCryptographicHash::Sha256);
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly))
        return "unreadable";
    hash.addData(file.readAll());
    file.close();
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
