#include "demo/schema.h"

namespace ardcard::demo {

QString SchemaSql(Dialect dialect) {
    QString script = QString::fromUtf8(SchemaScriptText());
    if (dialect == Dialect::PostgreSql)
        script.remove(QStringLiteral(" COLLATE NOCASE"));
    return script;
}

QStringList SchemaStatements(Dialect dialect) {
    QStringList statements;
    QString current;
    const QStringList lines = SchemaSql(dialect).split(u'\n');
    for (const QString& line : lines) {
        const QString trimmed = line.trimmed();
        if (trimmed.isEmpty() || trimmed.startsWith(QStringLiteral("--")))
            continue;
        if (!current.isEmpty())
            current += u'\n';
        current += line;
        if (trimmed.endsWith(u';')) {
            current.chop(current.size() - current.lastIndexOf(u';'));
            statements.append(current);
            current.clear();
        }
    }
    if (!current.trimmed().isEmpty())
        statements.append(current);
    return statements;
}

} // namespace ardcard::demo
