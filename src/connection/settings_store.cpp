#include "connection/settings_store.h"

#include "common/failure.h"
#include "common/module_state.h"
#include "connection/ini_file.h"
#include "connection/settings_keys.h"

#include <QStandardPaths>
#include <cmath>

namespace ardcard {

namespace {

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

QString SettingsFilePath(const QString& app) {
    return QStandardPaths::writableLocation(QStandardPaths::GenericConfigLocation) + u'/' + app +
           QStringLiteral(".ini");
}

QString ReadSetting(const QString& app, const QString& section, const QString& key,
                    const QString& fallback) {
    return IniFile(SettingsFilePath(app)).read(section, key).value_or(fallback);
}

void SaveSetting(const QString& app, const QString& section, const QString& key,
                 const QString& value) {
    IniFile(SettingsFilePath(app)).write(section, key, value);
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
