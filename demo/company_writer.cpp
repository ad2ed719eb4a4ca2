#include "demo/company_writer.h"

#include "common/failure.h"
#include "demo/schema.h"

#include <QAtomicInteger>
#include <QFile>
#include <QFileInfo>
#include <QSqlError>
#include <QStringList>
#include <QtDebug>

namespace ardcard::demo {

namespace {

QString nextConnectionName() {
    static QAtomicInteger<quint64> counter;
    return QStringLiteral("ardcard-demo-writer-%1").arg(++counter);
}

void removeFile(const QString& path) {
    if (QFileInfo::exists(path) && !QFile::remove(path))
        throw Failure(QStringLiteral("לא ניתן למחוק את הקובץ %1").arg(path));
}

} // namespace

void CreateCompanyFile(const QString& path) {
    removeFile(path);
    removeFile(path + QStringLiteral("-journal"));
    // An empty file is an empty SQLite database; creating it here keeps the
    // writer from creating files by accident when it is handed a wrong path.
    QFile file(path);
    if (!file.open(QIODevice::WriteOnly))
        throw Failure(
            QStringLiteral("לא ניתן ליצור את הקובץ %1: %2").arg(path, file.errorString()));
    file.close();
    CompanyWriter writer(path);
    for (const QString& statement : SchemaStatements(Dialect::Sqlite))
        writer.exec(statement);
    writer.commit();
}

CompanyWriter::CompanyWriter(const QString& path) : name_(nextConnectionName()) {
    if (!QFileInfo::exists(path))
        throw Failure(QStringLiteral("קובץ בסיס הנתונים %1 לא נמצא").arg(path));
    db_ = QSqlDatabase::addDatabase(QStringLiteral("QSQLITE"), name_);
    db_.setDatabaseName(path);
    if (!db_.open())
        fail(db_.lastError(), path);
    // The files are built from scratch and rebuilt at will, so a crash costs
    // nothing worth a synced journal.
    exec(QStringLiteral("PRAGMA synchronous = OFF"));
    exec(QStringLiteral("PRAGMA journal_mode = MEMORY"));
}

CompanyWriter::~CompanyWriter() {
    try {
        commit();
    } catch (const Failure& failure) {
        qWarning("Company file not committed: %s", failure.what());
    }
    prepared_.clear();
    db_.close();
    db_ = QSqlDatabase();
    QSqlDatabase::removeDatabase(name_);
}

void CompanyWriter::begin() {
    if (inTransaction_)
        return;
    if (!db_.transaction())
        fail(db_.lastError(), QStringLiteral("BEGIN"));
    inTransaction_ = true;
}

void CompanyWriter::commit() {
    if (!inTransaction_)
        return;
    inTransaction_ = false;
    if (!db_.commit())
        fail(db_.lastError(), QStringLiteral("COMMIT"));
}

void CompanyWriter::exec(const QString& sql) {
    // The journal mode cannot change inside a transaction.
    if (!sql.startsWith(QStringLiteral("PRAGMA"), Qt::CaseInsensitive))
        begin();
    QSqlQuery query(db_);
    if (!query.exec(sql))
        fail(query.lastError(), sql);
}

void CompanyWriter::insert(const QString& table, const Columns& columns) {
    QStringList names;
    QStringList marks;
    QVariantList values;
    for (const auto& [name, value] : columns) {
        names.append(name);
        marks.append(QStringLiteral("?"));
        values.append(value);
    }
    execPrepared(
        QStringLiteral("INSERT INTO %1 (%2) VALUES (%3)")
            .arg(table, names.join(QStringLiteral(", ")), marks.join(QStringLiteral(", "))),
        values);
}

void CompanyWriter::execPrepared(const QString& sql, const QVariantList& values) {
    begin();
    auto it = prepared_.find(sql);
    if (it == prepared_.end()) {
        QSqlQuery query(db_);
        if (!query.prepare(sql))
            fail(query.lastError(), sql);
        it = prepared_.emplace(sql, std::move(query)).first;
    }
    QSqlQuery& query = it->second;
    for (qsizetype i = 0; i < values.size(); ++i)
        query.bindValue(static_cast<int>(i), values[i]);
    if (!query.exec())
        fail(query.lastError(), sql);
}

void CompanyWriter::fail(const QSqlError& error, const QString& sql) const {
    QString text = error.databaseText().trimmed();
    if (text.isEmpty())
        text = error.text().trimmed();
    throw Failure(text + QStringLiteral(" (") + sql + u')', error.nativeErrorCode().toInt());
}

} // namespace ardcard::demo
