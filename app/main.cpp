// ardcard: places the account card the way a hosting page would, and either
// shows it until the user closes it or lets a script drive it.

#include "arguments.h"
#include "recording_seams.h"
#include "script_host.h"
#include "ui_driver.h"

#include "card/card.h"
#include "common/failure.h"
#include "demo/demo_builder.h"
#include "host/builtin_page_window.h"
#include "host/hosting_page.h"
#include "host/seams.h"
#include "info/ard7info.h"

#include <QApplication>
#include <QDir>
#include <QFileInfo>
#include <QMainWindow>
#include <QPointer>
#include <QScreen>
#include <QStandardPaths>
#include <cstdio>
#include <memory>
#include <optional>

using namespace ardcard;

namespace {

void printError(const QString& text) {
    std::fprintf(stderr, "%s\n", text.toUtf8().constData());
    std::fflush(stderr);
}

// The demo company lives with the user's data; it is built once.
QString demoDirectory() {
    QString dir = QStandardPaths::writableLocation(QStandardPaths::GenericDataLocation) +
                  QStringLiteral("/ardcard/demo");
    const QDir d(dir);
    if (!QFileInfo::exists(d.filePath(demo::DemoFileName())) ||
        !QFileInfo::exists(d.filePath(demo::Demo2FileName()))) {
        QDir().mkpath(dir);
        demo::BuildDemoCompany(dir);
    }
    return dir;
}

// The page the card is placed on: the demo's values first, where asked for,
// and the values given on the command line over them.
host::FixedHostingPage hostingPage(const app::Arguments& args) {
    host::FixedHostingPage page(args.address, {});
    if (args.demo) {
        page.setValue(QStringLiteral("AServer"), demoDirectory());
        page.setValue(QStringLiteral("AConnType"), QStringLiteral("4"));
        page.setValue(QStringLiteral("ADatabase"),
                      demo::DemoFileName() + u';' + demo::Demo2FileName());
        page.setValue(QStringLiteral("AAccount"), demo::DemoAccountKey());
    }
    for (auto it = args.values.cbegin(); it != args.values.cend(); ++it)
        page.setValue(it.key(), it.value());
    return page;
}

// The seams the run shows its messages and pages through.
struct RunSeams {
    std::unique_ptr<host::MessageRecorder> headlessMessages;
    std::unique_ptr<host::PageWindowRecorder> headlessWindows;
    host::GuiMessageBox guiMessages;
    host::BuiltInPageWindowFactory builtIn;
    host::DesktopBrowserFactory desktop;
    std::unique_ptr<app::RecordingMessageBox> recordedMessages;
    std::unique_ptr<app::RecordingPageWindows> recordedWindows;

    host::MessageRecorder* messageRecord = nullptr;
    host::PageWindowRecorder* windowRecord = nullptr;
    std::optional<host::ScopedSeams> installed;

    explicit RunSeams(const app::Arguments& args) {
        host::MessageBoxSeam* messages = nullptr;
        host::PageWindowFactory* windows = nullptr;
        if (args.headless) {
            headlessMessages = std::make_unique<host::MessageRecorder>(true);
            headlessWindows = std::make_unique<host::PageWindowRecorder>(true);
            messages = headlessMessages.get();
            windows = headlessWindows.get();
            messageRecord = headlessMessages.get();
            windowRecord = headlessWindows.get();
        } else {
            recordedMessages = std::make_unique<app::RecordingMessageBox>(guiMessages);
            host::PageWindowFactory& real =
                args.systemBrowser ? static_cast<host::PageWindowFactory&>(desktop) : builtIn;
            recordedWindows = std::make_unique<app::RecordingPageWindows>(real);
            messages = recordedMessages.get();
            windows = recordedWindows.get();
            messageRecord = &recordedMessages->record();
            windowRecord = &recordedWindows->record();
        }
        if (args.headless && args.systemBrowser)
            windows = &desktop;
        installed.emplace(messages, windows);
    }
};

int run(const app::Arguments& args) {
    RunSeams seams(args);

    QMainWindow window;
    window.setObjectName(QStringLiteral("cardWindow"));
    window.setWindowTitle(QStringLiteral("כרטסת חשבון"));
    window.setLayoutDirection(Qt::RightToLeft);
    auto* card = new Card; // creation: loads the stored connection values
    window.setCentralWidget(card);

    host::FixedHostingPage page;
    try {
        page = hostingPage(args);
    } catch (const Failure& f) {
        printError(QStringLiteral("error: the demo company: ") + f.description());
        return 1;
    }
    card->InitProperties(page); // first placing: every step goes on after a failure
    // Room for the grid: the card's own layout fits a handful of ledger rows.
    const QSize room = window.screen()->availableGeometry().size() * 9 / 10;
    window.resize(window.sizeHint().expandedTo(QSize(1200, 820)).boundedTo(room));
    window.show();

    if (args.script.isEmpty())
        return QApplication::exec();

    app::UiDriver ui(card, &card->ledger(), seams.messageRecord, seams.windowRecord);
    Ard7Info info;
    app::ScriptHost host;
    host.expose(QStringLiteral("card"), card);
    host.expose(QStringLiteral("info"), &info);
    host.exposePlain(QStringLiteral("ui"), &ui);
    return host.run(args.script);
}

} // namespace

int main(int argc, char** argv) {
    QStringList given;
    for (int i = 1; i < argc; ++i)
        given.append(QString::fromLocal8Bit(argv[i]));
    const app::ParseResult parsed = app::parseArguments(given);
    if (!parsed.error.isEmpty()) {
        printError(QStringLiteral("ardcard: ") + parsed.error);
        printError(app::usage());
        return 2;
    }
    const app::Arguments& args = parsed.arguments;
    if (args.help || args.version) {
        const QByteArray text = (args.help ? app::helpText() : app::versionText()).toUtf8();
        std::fwrite(text.constData(), 1, size_t(text.size()), stdout);
        return std::fflush(stdout) == 0 ? 0 : 1;
    }

    if (args.headless)
        qputenv("QT_QPA_PLATFORM", "offscreen");
    host::prepareWebEngine();
    QApplication application(argc, argv);
    QApplication::setApplicationName(QStringLiteral("ardcard"));
    QApplication::setLayoutDirection(Qt::RightToLeft);

    const int code = run(args);
    // Page windows still open belong to the user until the process ends;
    // they go before the application object does.
    QList<QPointer<QWidget>> windows;
    for (QWidget* w : QApplication::topLevelWidgets())
        if (!w->parent())
            windows.append(w);
    for (const QPointer<QWidget>& w : windows)
        delete w.data();
    return code;
}
