#pragma once

#include <QObject>
#include <QString>
#include <QVariant>

namespace ardcard {

// The per-user settings store: one INI file per application name
// ($XDG_CONFIG_HOME/<app>.ini, see ini_file.h), one section per settings
// section, values as text. The file holds the password, so it is kept
// readable and writable by its owner only.
//
// Every key with its default lives in settings_keys.h.

inline const QString kRegApp = QStringLiteral("VL7Trans");
inline const QString kRegSection = QStringLiteral("Params");

QString SettingsFilePath(const QString& app);

// The stored text, or `fallback` when the key is missing or the store cannot
// be read. Never fails.
QString ReadSetting(const QString& app, const QString& section, const QString& key,
                    const QString& fallback);
// Stores one text value; throws Failure when the store cannot be written.
void SaveSetting(const QString& app, const QString& section, const QString& key,
                 const QString& value);

// Loads the five connection values of the calling thread's module state, in
// the order ConnServer, ConnUID, ConnPWD, ConnDataBase, ConnType. A stored
// type that is not a number leaves ConnType as it was; the stored number is
// the dialog's list position, so the type is that number + 1.
void ReadConnParams();

// Saves (action 1) or loads (action 2) one screen control's value, through
// its Qt property: kind 1 its text ("text"), kind 2 its list position
// ("currentIndex"), kind 3 its check value 0/1 ("checked"). Any other action
// or kind does nothing. Loading a list position or check value that is not a
// number leaves the control as it was. Saving throws Failure.
enum RegAction : int { RegSave = 1, RegLoad = 2 };
enum RegKind : int { RegText = 1, RegListIndex = 2, RegValue = 3 };
void SetGetRegControl(int action, const QString& regApp, const QString& regSection,
                      const QString& key, QObject* control, int kind, const QVariant& fallback);

} // namespace ardcard
