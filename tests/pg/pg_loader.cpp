// Loads the fixture companies into the test server: builds them as SQLite
// files with the fixture writer, creates the host product's schema in each
// server database and copies every table's rows across through the ODBC
// driver the card itself uses. Run by the start script once the server and
// its private ODBC configuration are up.
//
//   pg_loader <work dir>
//   pg_loader --login      prints the fixture login: user, a space, password
// The server is reached as "127.0.0.1" with the fixture login; the port comes
// from the environment (PGPORT), as it does for the tests.

#include "common/failure.h"
#include "demo/schema.h"
#include "pg/pg_fixture.h"

#include <QCoreApplication>
#include <QDir>
#include <QSqlDatabase>
#include <QSqlError>
#include <QSqlQuery>
#include <QSqlRecord>
#include <QStringList>
#include <QVariant>
#include <cstdio>

namespace {

[[noreturn]] void fail(const QString& what, const QSqlError& error) {
    throw ardcard::Failure(what + QStringLiteral(": ") + error.text());
}

// A value as an SQL literal; the SQLite file keeps dates as ISO text, which
// the server turns into its DATE on insertion.
QString literal(const QVariant& value) {
    if (value.isNull())
        return QStringLiteral("NULL");
    switch (value.typeId()) {
    case QMetaType::Int:
    case QMetaType::LongLong:
    case QMetaType::UInt:
    case QMetaType::ULongLong:
        return value.toString();
    case QMetaType::Double:
        return QString::number(value.toDouble(), 'g', 17);
    default: {
        QString text = value.toString();
        text.replace(u'\'', QStringLiteral("''"));
        return u'\'' + text + u'\'';
    }
    }
}

void exec(QSqlDatabase& db, const QString& sql) {
    QSqlQuery query(db);
    if (!query.exec(sql))
        fail(sql.left(200), query.lastError());
}

void copyCompany(const QString& sqlitePath, const QString& database) {
    const QString sourceName = QStringLiteral("source-") + database;
    const QString targetName = QStringLiteral("target-") + database;
    {
        QSqlDatabase source = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), sourceName);
        source.setDatabaseName(sqlitePath);
        source.setConnectOptions(QStringLiteral("QSQLITE_OPEN_READONLY"));
        if (!source.open())
            fail(sqlitePath, source.lastError());

        QSqlDatabase target = QSqlDatabase::addDatabase(QStringLiteral("QODBC"), targetName);
        target.setDatabaseName(QStringLiteral("driver={SQL Server};server=127.0.0.1;uid=") +
                               pgfixture::user() + QStringLiteral(";pwd=") + pgfixture::password() +
                               QStringLiteral(";database=") + database);
        if (!target.open())
            fail(database, target.lastError());

        for (const QString& statement :
             ardcard::demo::SchemaStatements(ardcard::demo::Dialect::PostgreSql))
            exec(target, statement);

        QSqlQuery tables(source);
        if (!tables.exec(QStringLiteral("SELECT name FROM sqlite_master WHERE type = 'table'"
                                        " ORDER BY name")))
            fail(sqlitePath, tables.lastError());
        QStringList present;
        while (tables.next())
            present << tables.value(0).toString();
        // A table the fixture dropped is dropped on the server as well.
        QSqlQuery all(target);
        if (!all.exec(
                QStringLiteral("SELECT table_name FROM information_schema.tables"
                               " WHERE table_schema = 'public' AND table_type = 'BASE TABLE'")))
            fail(database, all.lastError());
        QStringList dropped;
        while (all.next()) {
            const QString name = all.value(0).toString();
            if (!present.contains(name, Qt::CaseInsensitive))
                dropped << name;
        }
        for (const QString& name : dropped)
            exec(target, QStringLiteral("DROP TABLE ") + name + QStringLiteral(" CASCADE"));

        for (const QString& table : present) {
            QSqlQuery rows(source);
            rows.setForwardOnly(true);
            if (!rows.exec(QStringLiteral("SELECT * FROM ") + table +
                           QStringLiteral(" ORDER BY rowid")))
                fail(table, rows.lastError());
            const QSqlRecord record = rows.record();
            QStringList columns;
            for (int i = 0; i < record.count(); ++i)
                columns << record.fieldName(i);
            const QString head = QStringLiteral("INSERT INTO ") + table + QStringLiteral(" (") +
                                 columns.join(QStringLiteral(", ")) + QStringLiteral(") VALUES ");
            QStringList batch;
            const auto flush = [&] {
                if (!batch.isEmpty())
                    exec(target, head + batch.join(QStringLiteral(", ")));
                batch.clear();
            };
            while (rows.next()) {
                QStringList values;
                for (int i = 0; i < record.count(); ++i)
                    values << literal(rows.value(i));
                batch << u'(' + values.join(QStringLiteral(", ")) + u')';
                if (batch.size() == 100)
                    flush();
            }
            flush();
        }
        target.close();
        source.close();
    }
    QSqlDatabase::removeDatabase(targetName);
    QSqlDatabase::removeDatabase(sourceName);
}

} // namespace

int main(int argc, char** argv) {
    QCoreApplication app(argc, argv);
    if (argc == 2 && qstrcmp(argv[1], "--login") == 0) {
        std::printf("%s %s\n", qPrintable(pgfixture::user()), qPrintable(pgfixture::password()));
        return 0;
    }
    if (argc != 2) {
        std::fprintf(stderr, "usage: pg_loader <work dir>\n");
        return 2;
    }
    const QString dir = QString::fromLocal8Bit(argv[1]);
    try {
        pgfixture::buildSqliteCompanies(dir);
        for (const QString& database :
             {pgfixture::company1(), pgfixture::company2(), pgfixture::noAccounts()})
            copyCompany(QDir(dir).filePath(database + QStringLiteral(".db")), database);
    } catch (const ardcard::Failure& failure) {
        std::fprintf(stderr, "pg_loader: %s\n", qPrintable(failure.description()));
        return 1;
    }
    return 0;
}
