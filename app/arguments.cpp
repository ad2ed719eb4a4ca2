#include "arguments.h"

#include <QFileInfo>

namespace ardcard::app {

QString usage() {
    return QStringLiteral("usage: ardcard [--address TEXT] [--set NAME=VALUE]... [--script FILE] "
                          "[--headless] [--system-browser] [--demo]");
}

ParseResult parseArguments(const QStringList& args) {
    ParseResult out;
    Arguments& a = out.arguments;
    for (qsizetype i = 0; i < args.size(); ++i) {
        const QString& arg = args[i];
        auto takeValue = [&](QString& target) {
            if (i + 1 >= args.size()) {
                out.error = QStringLiteral("%1 needs a value").arg(arg);
                return false;
            }
            target = args[++i];
            return true;
        };
        if (arg == u"--headless") {
            a.headless = true;
        } else if (arg == u"--system-browser") {
            a.systemBrowser = true;
        } else if (arg == u"--demo") {
            a.demo = true;
        } else if (arg == u"--address") {
            if (!takeValue(a.address))
                return out;
        } else if (arg == u"--script") {
            if (!takeValue(a.script))
                return out;
            if (!QFileInfo(a.script).isFile()) {
                out.error = QStringLiteral("no such script file: %1").arg(a.script);
                return out;
            }
        } else if (arg == u"--set") {
            QString pair;
            if (!takeValue(pair))
                return out;
            const qsizetype eq = pair.indexOf(u'=');
            if (eq <= 0) {
                out.error = QStringLiteral("--set needs NAME=VALUE, got: %1").arg(pair);
                return out;
            }
            a.values.insert(pair.left(eq), pair.mid(eq + 1));
        } else {
            out.error = QStringLiteral("unknown argument: %1").arg(arg);
            return out;
        }
    }
    return out;
}

} // namespace ardcard::app
