// ardcard-shoot DEMO_DIR OUT_DIR: places a card on the demo company in a
// window, fetches an account's lines and saves what a clerk sees: the card,
// the statement, the graph and the account's information page, each as a
// PNG in OUT_DIR. Meant to run on a real X server (Xvfb): the pages are
// taken from the screen, as they were drawn.

#include <ardcard/card.h>
#include <ardcard/prepare_web_engine.h>

#include <QApplication>
#include <QComboBox>
#include <QDir>
#include <QEventLoop>
#include <QLabel>
#include <QMainWindow>
#include <QMouseEvent>
#include <QPushButton>
#include <QScreen>
#include <QTimer>
#include <cstdio>

namespace {

void wait(int ms) {
    QEventLoop loop;
    QTimer::singleShot(ms, &loop, &QEventLoop::quit);
    loop.exec();
}

bool save(QWidget* window, const QString& file) {
    window->raise();
    window->activateWindow();
    wait(300);
    const QRect frame = window->frameGeometry();
    const QPixmap shot =
        window->screen()->grabWindow(0, frame.x(), frame.y(), frame.width(), frame.height());
    const bool ok = shot.save(file);
    std::printf("%s %s\n", ok ? "wrote" : "could not write", file.toLocal8Bit().constData());
    return ok;
}

// The page window a command opened last.
QWidget* newestPageWindow(const QList<QWidget*>& before) {
    for (QWidget* w : QApplication::topLevelWidgets())
        if (w->isVisible() && w->objectName() == u"pageWindow" && !before.contains(w))
            return w;
    return nullptr;
}

bool shootPage(const QString& file, const std::function<void()>& command) {
    const QList<QWidget*> before = QApplication::topLevelWidgets();
    command();
    QWidget* page = nullptr;
    for (int i = 0; i < 50 && !page; ++i) {
        wait(100);
        page = newestPageWindow(before);
    }
    if (!page) {
        std::fprintf(stderr, "no page window for %s\n", file.toLocal8Bit().constData());
        return false;
    }
    page->resize(1100, 760);
    page->move(40, 40);
    wait(2500); // the page loads and lays itself out
    const bool ok = save(page, file);
    page->close();
    return ok;
}

void doubleClick(QWidget* w) {
    const QPointF at(w->width() / 2.0, w->height() / 2.0);
    const QPointF global = w->mapToGlobal(at);
    for (QEvent::Type type : {QEvent::MouseButtonPress, QEvent::MouseButtonRelease,
                              QEvent::MouseButtonDblClick, QEvent::MouseButtonRelease}) {
        QMouseEvent event(type, at, global, Qt::LeftButton,
                          type == QEvent::MouseButtonRelease ? Qt::NoButton : Qt::LeftButton,
                          Qt::NoModifier);
        QCoreApplication::sendEvent(w, &event);
    }
}

} // namespace

int main(int argc, char** argv) {
    ardcard::host::prepareWebEngine();
    QApplication app(argc, argv);
    QApplication::setLayoutDirection(Qt::RightToLeft);
    const QStringList args = QApplication::arguments();
    if (args.size() != 3) {
        std::fprintf(stderr, "usage: ardcard-shoot DEMO_DIR OUT_DIR\n");
        return 2;
    }
    const QString demo = QDir(args[1]).absolutePath();
    const QDir out(args[2]);

    QMainWindow window;
    window.setWindowTitle(QStringLiteral("כרטסת חשבון"));
    auto* card = new ardcard::Card;
    window.setCentralWidget(card);
    window.move(0, 0);
    window.resize(1240, 860);
    window.show();
    card->ShowAccount(demo, QString(), QString(), 4, QStringLiteral("demo.db;demo2.db"),
                      QStringLiteral("10001"));
    wait(1000);

    bool ok = save(&window, out.filePath(QStringLiteral("card.png")));
    ok &= shootPage(out.filePath(QStringLiteral("statement.png")), [card] {
        card->findChild<QPushButton*>(QStringLiteral("PrintButt"))->click();
    });
    ok &= shootPage(out.filePath(QStringLiteral("graph.png")), [card] {
        card->findChild<QComboBox*>(QStringLiteral("CmbGraphType"))->setCurrentIndex(1);
        card->findChild<QPushButton*>(QStringLiteral("CmdGraph"))->click();
    });
    ok &= shootPage(out.filePath(QStringLiteral("account-page.png")),
                    [card] { doubleClick(card->findChild<QLabel*>(QStringLiteral("imgAccKey"))); });
    return ok ? 0 : 1;
}
