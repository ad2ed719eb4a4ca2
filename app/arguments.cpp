#include "arguments.h"

#include "ardcard/version.h"

#include <QFileInfo>

namespace ardcard::app {

QString usage() {
    return QStringLiteral("usage: ardcard [--address TEXT] [--set NAME=VALUE]... [--script FILE] "
                          "[--headless] [--system-browser] [--demo]\n"
                          "       ardcard --help | --version");
}

QString helpText() {
    return QStringLiteral(
        "Usage: ardcard [OPTION]...\n"
        "Show the account card of an Ardeco company database, placed the way a\n"
        "hosting page places it, and let the clerk or a container script drive it.\n"
        "\n"
        "Options:\n"
        "  --address TEXT      the hosting page's address; the text after the first\n"
        "                      \"#\" lists the company directories, separated by\n"
        "                      \";\" or \",\"\n"
        "  --set NAME=VALUE    a named value of the hosting page: AServer, AUID, APWD,\n"
        "                      AConnType, ADatabase, AAccount or AOnlyOpen; may be\n"
        "                      given more than once\n"
        "  --script FILE       run the container script FILE against the placed card\n"
        "                      and exit when it ends, instead of showing the window\n"
        "  --headless          run without a display: messages and page windows are\n"
        "                      recorded for the script, not shown\n"
        "  --system-browser    show pages in the desktop's web browser instead of the\n"
        "                      built-in page window\n"
        "  --demo              place the card on the demo company, built on first use\n"
        "                      under $XDG_DATA_HOME/ardcard/demo\n"
        "  --help              show this help and exit\n"
        "  --version           show the version and exit\n"
        "\n"
        "Exit status:\n"
        "  0 when the window is closed or the script ends, 1 when the script fails\n"
        "  or the demo company cannot be built, 2 for a wrong command line.\n"
        "\n"
        "Files:\n"
        "  $XDG_CONFIG_HOME/VL7Trans.ini holds the connection values and options\n"
        "  (section [Params]); output pages are written to $TMPDIR.\n");
}

QString versionText() {
    return QStringLiteral("ardcard " ARDCARD_VERSION_STRING "\n");
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
        if (arg == u"--help") {
            a.help = true;
            return out;
        }
        if (arg == u"--version") {
            a.version = true;
            return out;
        }
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
