#include "script_host.h"

#include "common/failure.h"
#include "common/module_state.h"
#include "connection/conn_string.h"

#include <QFile>
#include <QMetaMethod>
#include <cstdio>
#include <exception>

namespace ardcard::app {

namespace {

void printLine(std::FILE* to, const QString& line) {
    std::fprintf(to, "%s\n", line.toUtf8().constData());
    std::fflush(to);
}

// A JavaScript Proxy that routes every member of a C++ object through the
// bridge; a name the object lacks reads as undefined.
const char* const kWrapper = R"JS(
(function (bridge, target) {
    return new Proxy({}, {
        get(_, name) {
            if (typeof name !== 'string')
                return undefined;
            if (bridge.isMethod(target, name))
                return function (...args) { return bridge.invoke(target, name, args); };
            if (bridge.isProperty(target, name))
                return bridge.get(target, name);
            return undefined;
        },
        set(_, name, value) {
            bridge.set(target, name, value);
            return true;
        },
        has(_, name) {
            return bridge.isMethod(target, name) || bridge.isProperty(target, name);
        }
    });
})
)JS";

const char* const kPrint = R"JS(
(function (bridge) {
    return function (...args) { bridge.print(args.map(String).join(' ')); };
})
)JS";

QList<QMetaMethod> methodsNamed(const QObject* target, const QString& name) {
    QList<QMetaMethod> out;
    if (!target)
        return out;
    const QMetaObject* meta = target->metaObject();
    const QByteArray wanted = name.toUtf8();
    for (int i = 0; i < meta->methodCount(); ++i) {
        const QMetaMethod m = meta->method(i);
        if (m.name() == wanted && m.access() == QMetaMethod::Public &&
            (m.methodType() == QMetaMethod::Method || m.methodType() == QMetaMethod::Slot))
            out.append(m);
    }
    return out;
}

} // namespace

QString ConnObject::BuildConnString(const QString& server, const QString& uid, const QVariant& pwd,
                                    const QString& database, int type) {
    return ardcard::BuildConnString(server, uid, pwd, database, type);
}

QVariantMap ConnObject::values() const {
    const ConnValues& c = moduleState().conn;
    return {{QStringLiteral("ConnServer"), c.ConnServer},
            {QStringLiteral("ConnUID"), c.ConnUID},
            {QStringLiteral("ConnPWD"), c.ConnPWD},
            {QStringLiteral("ConnDataBase"), c.ConnDataBase},
            {QStringLiteral("ConnType"), c.ConnType}};
}

bool ScriptBridge::isMethod(QObject* target, const QString& name) const {
    return !methodsNamed(target, name).isEmpty();
}

bool ScriptBridge::isProperty(QObject* target, const QString& name) const {
    return target && target->metaObject()->indexOfProperty(name.toUtf8().constData()) >= 0;
}

QVariant ScriptBridge::invoke(QObject* target, const QString& name, const QVariantList& args) {
    const QList<QMetaMethod> candidates = methodsNamed(target, name);
    const QMetaMethod* method = nullptr;
    for (const QMetaMethod& m : candidates)
        if (m.parameterCount() == args.size())
            method = &m;
    if (!method || args.size() > 10) {
        engine_.throwError(
            QJSValue::TypeError,
            QStringLiteral("%1: no form of it takes %2 arguments").arg(name).arg(args.size()));
        return {};
    }

    // Each argument in the type the member takes; a QVariant parameter gets
    // the value as it came (a JS null stays Null).
    QVariantList converted = args;
    QGenericArgument generic[10];
    for (int i = 0; i < method->parameterCount(); ++i) {
        const QMetaType type = method->parameterMetaType(i);
        QVariant& v = converted[i];
        if (type.id() == QMetaType::QVariant) {
            if (v.metaType().id() == QMetaType::Nullptr)
                v = QVariant();
            generic[i] = QGenericArgument("QVariant", &v);
            continue;
        }
        if (!v.convert(type)) {
            engine_.throwError(QJSValue::TypeError,
                               QStringLiteral("%1: argument %2 does not convert to %3")
                                   .arg(name)
                                   .arg(i + 1)
                                   .arg(QString::fromLatin1(type.name())));
            return {};
        }
        generic[i] = QGenericArgument(type.name(), v.data());
    }

    const QMetaType returnType = method->returnMetaType();
    QVariant result;
    if (returnType.id() != QMetaType::Void && returnType.id() != QMetaType::QVariant)
        result = QVariant(returnType);
    QGenericReturnArgument ret;
    if (returnType.id() == QMetaType::QVariant)
        ret = QGenericReturnArgument("QVariant", &result);
    else if (returnType.id() != QMetaType::Void)
        ret = QGenericReturnArgument(returnType.name(), result.data());

    try {
        method->invoke(target, Qt::DirectConnection, ret, generic[0], generic[1], generic[2],
                       generic[3], generic[4], generic[5], generic[6], generic[7], generic[8],
                       generic[9]);
    } catch (const Failure& f) {
        engine_.throwError(f.description());
        return {};
    } catch (const std::exception& e) {
        engine_.throwError(QString::fromUtf8(e.what()));
        return {};
    }
    return result;
}

QVariant ScriptBridge::get(QObject* target, const QString& name) {
    try {
        return target->property(name.toUtf8().constData());
    } catch (const Failure& f) {
        engine_.throwError(f.description());
    }
    return {};
}

void ScriptBridge::set(QObject* target, const QString& name, const QVariant& value) {
    if (!isProperty(target, name)) {
        engine_.throwError(QJSValue::TypeError, QStringLiteral("%1: no such property").arg(name));
        return;
    }
    const QVariant given = value.metaType().id() == QMetaType::Nullptr ? QVariant() : value;
    try {
        target->setProperty(name.toUtf8().constData(), given);
    } catch (const Failure& f) {
        engine_.throwError(f.description());
    }
}

void ScriptBridge::print(const QString& line) {
    printLine(stdout, line);
}

ScriptHost::ScriptHost() : bridge_(engine_) {
    for (QObject* own : std::initializer_list<QObject*>{&bridge_, &conn_})
        QJSEngine::setObjectOwnership(own, QJSEngine::CppOwnership);
    wrap_ = engine_.evaluate(QString::fromUtf8(kWrapper));
    engine_.globalObject().setProperty(
        QStringLiteral("print"),
        engine_.evaluate(QString::fromUtf8(kPrint)).call({engine_.newQObject(&bridge_)}));
    exposePlain(QStringLiteral("conn"), &conn_);
}

void ScriptHost::expose(const QString& name, QObject* object) {
    QJSEngine::setObjectOwnership(object, QJSEngine::CppOwnership);
    engine_.globalObject().setProperty(
        name, wrap_.call({engine_.newQObject(&bridge_), engine_.newQObject(object)}));
}

void ScriptHost::exposePlain(const QString& name, QObject* object) {
    QJSEngine::setObjectOwnership(object, QJSEngine::CppOwnership);
    engine_.globalObject().setProperty(name, engine_.newQObject(object));
}

int ScriptHost::run(const QString& fileName) {
    QFile file(fileName);
    if (!file.open(QIODevice::ReadOnly)) {
        printLine(stderr,
                  QStringLiteral("error: cannot read %1: %2").arg(fileName, file.errorString()));
        return 1;
    }
    const QString program = QString::fromUtf8(file.readAll());
    QStringList trace;
    const QJSValue result = engine_.evaluate(program, fileName, 1, &trace);
    if (result.isError() || !trace.isEmpty()) {
        QString where = fileName;
        if (result.isError() && result.hasProperty(QStringLiteral("lineNumber")))
            where += u':' + result.property(QStringLiteral("lineNumber")).toString();
        else if (!trace.isEmpty())
            where = trace.first();
        printLine(stderr, QStringLiteral("error: %1: %2").arg(where, result.toString()));
        return 1;
    }
    return 0;
}

} // namespace ardcard::app
