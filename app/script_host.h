#pragma once

#include <QJSEngine>
#include <QObject>
#include <QString>
#include <QVariant>

namespace ardcard::app {

// What a script reaches through `conn`: the connection string builder and
// the connection values in force on this thread.
class ConnObject : public QObject {
    Q_OBJECT
public:
    using QObject::QObject;
    Q_INVOKABLE QString BuildConnString(const QString& server, const QString& uid,
                                        const QVariant& pwd, const QString& database, int type);
    // {ConnServer, ConnUID, ConnPWD, ConnDataBase, ConnType}
    Q_INVOKABLE QVariantMap values() const;
};

// Calls into the objects a script drives. A member of the card that fails
// hands its failure to the caller; here that becomes a script exception the
// script may catch, instead of an exception crossing the script engine.
class ScriptBridge : public QObject {
    Q_OBJECT
public:
    explicit ScriptBridge(QJSEngine& engine) : engine_(engine) {}
    Q_INVOKABLE bool isMethod(QObject* target, const QString& name) const;
    Q_INVOKABLE bool isProperty(QObject* target, const QString& name) const;
    Q_INVOKABLE QVariant invoke(QObject* target, const QString& name, const QVariantList& args);
    Q_INVOKABLE QVariant get(QObject* target, const QString& name);
    Q_INVOKABLE void set(QObject* target, const QString& name, const QVariant& value);
    Q_INVOKABLE void print(const QString& line);

private:
    QJSEngine& engine_;
};

// Runs one script against a placed card, with the globals `card`, `ui`,
// `conn`, `print(...)` and, where given, `info`. The objects stay owned by
// the caller.
class ScriptHost {
public:
    ScriptHost();
    // `object`'s invokable members and properties under their own names.
    void expose(const QString& name, QObject* object);
    // `object` as it is (its members deal with their own failures).
    void exposePlain(const QString& name, QObject* object);
    // 0 when the script ends normally; 1 when it throws (the error and its
    // place on stderr).
    int run(const QString& fileName);

private:
    QJSEngine engine_;
    ScriptBridge bridge_;
    ConnObject conn_;
    QJSValue wrap_;
};

} // namespace ardcard::app
