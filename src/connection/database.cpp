#include "connection/database.h"

#include "common/failure.h"
#include "common/text_helpers.h"
#include "connection/driver_target.h"

#include <QSqlError>
#include <QSqlRecord>
#include <QSqlResult>
#include <QThread>
#include <sqlite3.h>

namespace ardcard {

namespace {

Failure toFailure(const QSqlError& error) {
    QString text = error.databaseText().trimmed();
    const QString driver = error.driverText().trimmed();
    if (text.isEmpty())
        text = driver;
    else if (!driver.isEmpty() && !text.contains(driver))
        text = driver + QStringLiteral(": ") + text;
    if (text.isEmpty())
        text = QStringLiteral("תקלה לא ידועה בבסיס הנתונים");
    bool ok = false;
    const int number = error.nativeErrorCode().toInt(&ok);
    return Failure(text, ok ? number : 0);
}

QString nextConnectionName() {
    thread_local quint64 counter = 0;
    return QStringLiteral("ardcard-%1-%2")
        .arg(reinterpret_cast<quintptr>(QThread::currentThreadId()))
        .arg(++counter);
}

bool declaredAsDate(const char* decl) {
    if (!decl)
        return false;
    const QByteArray type = QByteArray(decl).toUpper();
    return type.contains("DATE") || type.contains("TIME");
}

// Qt's ODBC driver puts "DSN=" in front of any text that names neither a
// driver nor a server, so a data-source string handed over as it is would
// ask for a data source called "DSN=name" and never connect.
QString odbcDatabaseName(const DriverTarget& target) {
    const QString& name = target.databaseName;
    const QString dsn = QStringLiteral("DSN=");
    if (target.driver != QStringLiteral("QODBC") || !name.startsWith(dsn, Qt::CaseInsensitive) ||
        name.contains(QStringLiteral("DRIVER="), Qt::CaseInsensitive) ||
        name.contains(QStringLiteral("SERVER="), Qt::CaseInsensitive))
        return name;
    return name.mid(dsn.size());
}

} // namespace

Connection::Connection() : name_(nextConnectionName()) {}

Connection::~Connection() {
    if (db_.isValid()) {
        db_.close();
        db_ = QSqlDatabase();
        QSqlDatabase::removeDatabase(name_);
    }
}

void Connection::open(const QString& connStr) {
    const DriverTarget target = MapConnString(connStr, timeout_);
    if (!QSqlDatabase::isDriverAvailable(target.driver))
        throw Failure(QStringLiteral("מנהל ההתקן %1 אינו מותקן").arg(target.driver));
    db_ = QSqlDatabase::addDatabase(target.driver, name_);
    db_.setDatabaseName(odbcDatabaseName(target));
    db_.setConnectOptions(target.options);
    sqlite_ = target.driver == QStringLiteral("QSQLITE");
    if (!db_.open())
        throw toFailure(db_.lastError());
}

Recordset::~Recordset() {
    Close();
}

void Recordset::Open(const QString& sql, CursorKind /*kind*/) {
    if (!bound_)
        throw Failure(QStringLiteral("אין חיבור פתוח לבסיס הנתונים"));
    Close();
    exec(*bound_, sql);
}

void Recordset::Open(const QString& sql, const QString& connStr, CursorKind /*kind*/) {
    Close();
    own_ = std::make_unique<Connection>();
    own_->open(connStr);
    exec(*own_, sql);
}

void Recordset::exec(Connection& connection, const QString& sql) {
    if (!connection.isOpen())
        throw Failure(QStringLiteral("אין חיבור פתוח לבסיס הנתונים"));
    sql_ = sql;
    query_.emplace(connection.database());
    // Every cursor reads forward: the callers only move forward, and a
    // scrollable SQLite or ODBC cursor would keep every row in memory.
    query_->setForwardOnly(true);
    if (!query_->exec(sql)) {
        const Failure failure = toFailure(query_->lastError());
        query_.reset();
        throw failure;
    }
    dateColumn_.assign(static_cast<size_t>(query_->record().count()), false);
    lastDate_.assign(dateColumn_.size(), LastDate{});
    if (connection.isSqlite()) {
        const QVariant handle = query_->result()->handle();
        if (handle.isValid() && qstrcmp(handle.typeName(), "sqlite3_stmt*") == 0) {
            auto* stmt = *static_cast<sqlite3_stmt* const*>(handle.constData());
            for (size_t i = 0; stmt && i < dateColumn_.size(); ++i)
                dateColumn_[i] = declaredAsDate(sqlite3_column_decltype(stmt, static_cast<int>(i)));
        }
    }
    position_ = 0;
    onRow_ = false;
    fetch();
}

void Recordset::fetch() {
    onRow_ = query_->next();
    if (!onRow_ && query_->lastError().isValid())
        throw toFailure(query_->lastError());
    if (onRow_)
        ++position_;
}

void Recordset::Close() {
    query_.reset();
    own_.reset();
    dateColumn_.clear();
    lastDate_.clear();
    onRow_ = false;
    position_ = 0;
}

void Recordset::MoveFirst() {
    if (!query_)
        throw Failure(QStringLiteral("קבוצת הרשומות סגורה"));
    if (position_ <= 1)
        return;
    if (!query_->exec(sql_))
        throw toFailure(query_->lastError());
    position_ = 0;
    fetch();
}

void Recordset::MoveNext() {
    if (!query_ || !onRow_)
        throw Failure(QStringLiteral("אין רשומה נוכחית"));
    fetch();
}

int Recordset::indexOf(const QString& name) const {
    return query_ ? query_->record().indexOf(name) : -1;
}

QVariant Recordset::value(int index) const {
    if (!query_ || !onRow_)
        throw Failure(QStringLiteral("אין רשומה נוכחית"));
    if (index < 0 || index >= static_cast<int>(dateColumn_.size()))
        throw Failure(QStringLiteral("השדה המבוקש אינו קיים"));
    QVariant v = query_->value(index);
    if (dateColumn_[static_cast<size_t>(index)] && v.typeId() == QMetaType::QString) {
        LastDate& last = lastDate_[static_cast<size_t>(index)];
        const QString& text = *static_cast<const QString*>(v.constData());
        if (text == last.text && last.date.isValid())
            return last.date;
        const QDate date = ToDate(v);
        if (date.isValid()) {
            last.text = text;
            last.date = date;
            return last.date;
        }
    }
    return v;
}

QVariant Recordset::field(const QString& name) const {
    const int index = indexOf(name);
    if (index < 0)
        throw Failure(QStringLiteral("השדה %1 אינו קיים בתוצאת השאילתה").arg(name));
    return value(index);
}

} // namespace ardcard
