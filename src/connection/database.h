#pragma once

#include <QSqlDatabase>
#include <QSqlQuery>
#include <QString>
#include <QVariant>
#include <memory>
#include <optional>
#include <vector>

namespace ardcard {

// The data-access layer: a connection opened from a connection string and
// result sets read forward from SQL text, over Qt SQL. Nothing here writes to
// the database; SQLite files are opened read-only. Every failure throws
// Failure with the driver's own description.
class Connection {
public:
    Connection();
    ~Connection(); // releasing closes
    Connection(const Connection&) = delete;
    Connection& operator=(const Connection&) = delete;

    // Login time-out in seconds: 60 for the card's reads, 2 for the check of
    // the information pages.
    void setTimeout(int seconds) { timeout_ = seconds; }
    int timeout() const { return timeout_; }
    void open(const QString& connStr);
    bool isOpen() const { return db_.isOpen(); }
    QSqlDatabase& database() { return db_; }
    bool isSqlite() const { return sqlite_; }

private:
    QString name_;
    QSqlDatabase db_;
    int timeout_ = 15;
    bool sqlite_ = false;
};

enum class CursorKind { ForwardOnly = 0, Dynamic = 2 };

// A read-only result set. Bound to an open connection, or opened with a
// connection string, in which case it opens (and releases) a connection of
// its own for each Open. Rows are read forward; MoveFirst goes back to the
// first row by running the query again when it has moved on.
class Recordset {
public:
    Recordset() = default;
    explicit Recordset(Connection& connection) : bound_(&connection) {}
    ~Recordset();
    Recordset(const Recordset&) = delete;
    Recordset& operator=(const Recordset&) = delete;

    void Open(const QString& sql, CursorKind kind = CursorKind::ForwardOnly);
    void Open(const QString& sql, const QString& connStr,
              CursorKind kind = CursorKind::ForwardOnly);
    void Close();
    bool isOpen() const { return query_.has_value(); }

    // Bof() && Eof(): the query returned no rows. (Named so because EOF is a
    // macro of the C library.)
    bool Bof() const { return position_ <= 0 && !onRow_; }
    bool Eof() const { return !onRow_; }
    void MoveFirst();
    void MoveNext();

    // Column index by name, ignoring case; -1 when absent.
    int indexOf(const QString& name) const;
    // The current row's value; a column declared as a date that SQLite keeps
    // as ISO text reads as a date. Throws for an unknown column or no row.
    QVariant value(int index) const;
    QVariant field(const QString& name) const;
    bool isNull(const QString& name) const { return field(name).isNull(); }

private:
    void exec(Connection& connection, const QString& sql);
    void fetch();

    Connection* bound_ = nullptr;
    std::unique_ptr<Connection> own_;
    std::optional<QSqlQuery> query_;
    std::vector<bool> dateColumn_;
    // The last ISO text read from each date column and its date: consecutive
    // rows mostly carry the same day.
    struct LastDate {
        QString text;
        QVariant date;
    };
    mutable std::vector<LastDate> lastDate_;
    QString sql_;
    qint64 position_ = 0;
    bool onRow_ = false;
};

} // namespace ardcard
