#pragma once

#include <QString>
#include <QStringList>

namespace ardcard::demo {

// The database engines a company schema is written for.
enum class Dialect { Sqlite, PostgreSql };

// The schema script of a company database: the tables, indexes and the price
// view that the card and the information pages read. For SQLite the script is
// returned as written; PostgreSQL has no NOCASE collation, so there the
// collations are dropped and keys compare as the server's collation does.
QString SchemaSql(Dialect dialect);

// The same script cut into single statements without their closing
// semicolon and without comment lines, ready to be run one by one.
QStringList SchemaStatements(Dialect dialect);

// The script exactly as demo/schema.sql holds it.
const char* SchemaScriptText();

} // namespace ardcard::demo
