#include "connection/ini_file.h"

#include "common/failure.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QSaveFile>
#include <QStringList>

namespace ardcard {

namespace {

bool isSectionLine(const QString& trimmed) {
    return trimmed.startsWith(u'[') && trimmed.endsWith(u']');
}

QString sectionName(const QString& trimmed) {
    return trimmed.mid(1, trimmed.size() - 2).trimmed();
}

// Splits "Key=Value"; false for lines that hold no key.
bool splitKeyLine(const QString& line, QString* key, QString* value) {
    const QString trimmed = line.trimmed();
    if (trimmed.isEmpty() || trimmed.startsWith(u';') || trimmed.startsWith(u'#'))
        return false;
    const qsizetype eq = line.indexOf(u'=');
    if (eq <= 0)
        return false;
    *key = line.left(eq).trimmed();
    *value = line.mid(eq + 1).trimmed();
    return !key->isEmpty();
}

QString unquote(const QString& value) {
    if (value.size() < 2 || !value.startsWith(u'"') || !value.endsWith(u'"'))
        return value;
    QString out;
    for (qsizetype i = 1; i < value.size() - 1; ++i) {
        const QChar c = value[i];
        if (c == u'\\' && i + 1 < value.size() - 1) {
            const QChar n = value[++i];
            out += (n == u'"' || n == u'\\') ? n : QString(c) + n;
        } else {
            out += c;
        }
    }
    return out;
}

QString quoteIfNeeded(const QString& value) {
    const bool needs = value != value.trimmed() || value.startsWith(u'"');
    if (!needs)
        return value;
    QString out = QStringLiteral("\"");
    for (const QChar c : value) {
        if (c == u'"' || c == u'\\')
            out += u'\\';
        out += c;
    }
    return out + u'"';
}

QStringList readLines(const QString& path, bool* ok) {
    QFile file(path);
    if (!file.exists()) {
        *ok = true;
        return {};
    }
    if (!file.open(QIODevice::ReadOnly)) {
        *ok = false;
        return {};
    }
    *ok = true;
    QString text = QString::fromUtf8(file.readAll());
    text.replace(QStringLiteral("\r\n"), QStringLiteral("\n"));
    QStringList lines = text.split(u'\n');
    if (!lines.isEmpty() && lines.last().isEmpty())
        lines.removeLast();
    return lines;
}

} // namespace

std::optional<QString> IniFile::read(const QString& section, const QString& key) const {
    bool ok = false;
    const QStringList lines = readLines(path_, &ok);
    bool inSection = false;
    for (const QString& line : lines) {
        const QString trimmed = line.trimmed();
        if (isSectionLine(trimmed)) {
            inSection = sectionName(trimmed).compare(section, Qt::CaseInsensitive) == 0;
            continue;
        }
        QString k;
        QString v;
        if (inSection && splitKeyLine(line, &k, &v) && k.compare(key, Qt::CaseInsensitive) == 0)
            return unquote(v);
    }
    return std::nullopt;
}

void IniFile::write(const QString& section, const QString& key, const QString& value) const {
    bool ok = false;
    QStringList lines = readLines(path_, &ok);
    if (!ok)
        throw Failure(
            QStringLiteral("לא ניתן לשמור את ההגדרות בקובץ %1: לא ניתן לקרוא אותו").arg(path_));

    const QString newLine = key + u'=' + quoteIfNeeded(value);
    qsizetype sectionStart = -1;
    qsizetype sectionEnd = lines.size(); // first line after the section
    bool done = false;
    for (qsizetype i = 0; i < lines.size() && !done; ++i) {
        const QString trimmed = lines[i].trimmed();
        if (isSectionLine(trimmed)) {
            if (sectionStart >= 0) {
                sectionEnd = i;
                break;
            }
            if (sectionName(trimmed).compare(section, Qt::CaseInsensitive) == 0)
                sectionStart = i;
            continue;
        }
        QString k;
        QString v;
        if (sectionStart >= 0 && splitKeyLine(lines[i], &k, &v) &&
            k.compare(key, Qt::CaseInsensitive) == 0) {
            lines[i] = newLine;
            done = true;
        }
    }
    if (!done) {
        if (sectionStart < 0) {
            if (!lines.isEmpty() && !lines.last().trimmed().isEmpty())
                lines.append(QString());
            lines.append(u'[' + section + u']');
            lines.append(newLine);
        } else {
            // after the section's last key line, before trailing blank lines
            qsizetype at = sectionEnd;
            while (at > sectionStart + 1 && lines[at - 1].trimmed().isEmpty())
                --at;
            lines.insert(at, newLine);
        }
    }

    QDir().mkpath(QFileInfo(path_).absolutePath());
    QSaveFile file(path_);
    if (!file.open(QIODevice::WriteOnly))
        throw Failure(
            QStringLiteral("לא ניתן לשמור את ההגדרות בקובץ %1: %2").arg(path_, file.errorString()));
    file.setPermissions(QFile::ReadOwner | QFile::WriteOwner);
    file.write((lines.join(u'\n') + u'\n').toUtf8());
    if (!file.commit())
        throw Failure(
            QStringLiteral("לא ניתן לשמור את ההגדרות בקובץ %1: %2").arg(path_, file.errorString()));
}

} // namespace ardcard
