#include "connection/settings_store.h"

#include "common/failure.h"
#include "common/module_state.h"
#include "connection/settings_keys.h"

#include <QFile>
#include <QSettings>
#include <cmath>

namespace ardcard {

namespace {

QString storedText(const QVariant& v) {
    // A hand-written "a,b" reads back from INI as a list; it is one text.
    if (v.typeId() == QMetaType::QStringList)
        return v.toStringList().join(u',');
    return v.toString();
}

// A number in the settings' text, rounded to the nearest whole number
// (halves to even); false when the text is not a number.
bool storedNumber(const QString& text, int* out) {
    bool ok = false;
    const double d = text.trimmed().toDouble(&ok);
    if (!ok || !std::isfinite(d) || std::fabs(d) > 32767.0)
        return false;
    *out = static_cast<int>(std::nearbyint(d));
    return true;
}

} // namespace

QString ReadSetting(const QString& app, const QString& section, const QString& key,
                    const QString& fallback) {
    QSettings settings(QSettings::IniFormat, QSettings::UserScope, app);
    settings.sync(); // see edits made by other programs since the last read
    if (settings.status() != QSettings::NoError)
        return fallback;
    settings.beginGroup(section);
    const QVariant v = settings.value(key);
    if (!v.isValid())
        return fallback;
    return storedText(v);
}

void SaveSetting(const QString& app, const QString& section, const QString& key,
                 const QString& value) {
    QSettings settings(QSettings::IniFormat, QSettings::UserScope, app);
    settings.beginGroup(section);
    settings.setValue(key, value);
    settings.endGroup();
    settings.sync();
    const QString file = settings.fileName();
    if (settings.status() != QSettings::NoError)
        throw Failure(QStringLiteral("לא ניתן לשמור את ההגדרות בקובץ %1").arg(file));
    QFile::setPermissions(file, QFile::ReadOwner | QFile::WriteOwner);
}

void ReadConnParams() {
    ConnValues& c = moduleState().conn;
    c.ConnServer = ReadSetting(kRegApp, kRegSection, keys::name(keys::ConnServer),
                               keys::fallback(keys::ConnServer));
    c.ConnUID =
        ReadSetting(kRegApp, kRegSection, keys::name(keys::ConnUID), keys::fallback(keys::ConnUID));
    c.ConnPWD =
        ReadSetting(kRegApp, kRegSection, keys::name(keys::ConnPWD), keys::fallback(keys::ConnPWD));
    c.ConnDataBase = ReadSetting(kRegApp, kRegSection, keys::name(keys::ConnDataBase),
                                 keys::fallback(keys::ConnDataBase));
    bool ok = false;
    const QString type = ReadSetting(kRegApp, kRegSection, keys::name(keys::ConnType),
                                     keys::fallback(keys::ConnType));
    const double position = type.trimmed().toDouble(&ok);
    if (ok && std::isfinite(position) && std::fabs(position + 1) <= 32767.0)
        c.ConnType = static_cast<int>(std::nearbyint(position + 1));
}

void SetGetRegControl(int action, const QString& regApp, const QString& regSection,
                      const QString& key, QObject* control, int kind, const QVariant& fallback) {
    if (!control || (action != RegSave && action != RegLoad))
        return;
    const char* property = nullptr;
    switch (kind) {
    case RegText:
        property = "text";
        break;
    case RegListIndex:
        property = "currentIndex";
        break;
    case RegValue:
        property = "checked";
        break;
    default:
        return;
    }

    if (action == RegSave) {
        const QVariant v = control->property(property);
        QString text;
        if (kind == RegValue)
            text = v.toBool() ? QStringLiteral("1") : QStringLiteral("0");
        else
            text = v.toString();
        SaveSetting(regApp, regSection, key, text);
        return;
    }

    const QString text = ReadSetting(regApp, regSection, key, fallback.toString());
    if (kind == RegText) {
        control->setProperty(property, text);
        return;
    }
    int number = 0;
    if (!storedNumber(text, &number))
        return; // does not convert: the control keeps its value
    if (kind == RegValue) {
        control->setProperty(property, number != 0);
    } else {
        const int count = control->property("count").toInt();
        if (number >= -1 && number < count)
            control->setProperty(property, number);
    }
}

} // namespace ardcard
