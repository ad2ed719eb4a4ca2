#pragma once

#include <QList>
#include <QPair>
#include <QSqlDatabase>
#include <QSqlQuery>
#include <QString>
#include <QVariant>
#include <QVariantList>
#include <map>

namespace ardcard::demo {

// Replaces any file at `path` with a new SQLite company file that holds the
// empty schema. Throws Failure when the file cannot be replaced or written.
void CreateCompanyFile(const QString& path);

// Writes rows into an existing company file: the fixture factory of the tests
// and the engine of the demo builders. It opens the file read-write through a
// connection of its own (the readers of the system open company files
// read-only) and gathers every statement into one transaction, committed by
// commit() or on destruction, because a file written row by row outside a
// transaction takes minutes instead of seconds. Every failure throws Failure
// with the driver's text.
class CompanyWriter {
public:
    using Columns = QList<QPair<QString, QVariant>>;

    explicit CompanyWriter(const QString& path);
    ~CompanyWriter(); // commits what is pending
    CompanyWriter(const CompanyWriter&) = delete;
    CompanyWriter& operator=(const CompanyWriter&) = delete;

    void exec(const QString& sql);
    // One row; a QVariant() column value is written as Null.
    void insert(const QString& table, const Columns& columns);
    // A statement with "?" placeholders, prepared once per text and reused:
    // the fast path for bulk rows.
    void execPrepared(const QString& sql, const QVariantList& values);
    void commit();

private:
    void begin();
    [[noreturn]] void fail(const QSqlError& error, const QString& sql) const;

    QString name_;
    QSqlDatabase db_;
    bool inTransaction_ = false;
    std::map<QString, QSqlQuery> prepared_;
};

} // namespace ardcard::demo
