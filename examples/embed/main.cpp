// ardcard-embed: two account cards side by side in one main window, driven
// through the card's public members only.
//
//   ardcard-embed [DIR]              show the window; with DIR, the left card
//                                    opens DIR/demo.db and the right one
//                                    DIR/demo2.db (made by `ardcard-demo DIR`)
//   ardcard-embed --self-test DIR    place both, print what each shows, exit
//
// Both cards live on the one user-interface thread, so they share the
// company directories and connection values: whichever card sets them last
// decides what the other one reads next.

#include <ardcard/card.h>
#include <ardcard/failure.h>
#include <ardcard/prepare_web_engine.h>
#include <ardcard/version.h>

#include <QAbstractItemModel>
#include <QApplication>
#include <QDir>
#include <QFileInfo>
#include <QHBoxLayout>
#include <QLineEdit>
#include <QMainWindow>
#include <QPushButton>
#include <QTableView>
#include <cstdio>

namespace {

// An account with journal lines in both demo companies.
const QString kAccountKey = QStringLiteral("10001");

class TwoCards : public QMainWindow {
public:
    TwoCards() {
        setWindowTitle(QStringLiteral("שתי כרטסות"));
        setLayoutDirection(Qt::RightToLeft);
        auto* central = new QWidget;
        auto* row = new QHBoxLayout(central);
        left = new ardcard::Card;
        right = new ardcard::Card;
        row->addWidget(left);
        row->addWidget(right);
        setCentralWidget(central);
    }

    // Each card shows the account in its own company and fetches its lines.
    void open(const QString& dir) {
        left->ShowAccount(dir, QString(), QString(), 4, QStringLiteral("demo.db"), kAccountKey);
        right->ShowAccount(dir, QString(), QString(), 4, QStringLiteral("demo2.db"), kAccountKey);
    }

    ardcard::Card* left = nullptr;
    ardcard::Card* right = nullptr;
};

// What the clerk reads on a card, plus the shared company directories.
QString describe(const char* side, ardcard::Card* card) {
    const auto text = [card](const char* name) {
        const auto* box = card->findChild<QLineEdit*>(QLatin1String(name));
        return box ? box->text() : QStringLiteral("?");
    };
    const auto* grid = card->findChild<QTableView*>(QStringLiteral("DocLines"));
    const int rows = grid && grid->model() ? grid->model()->rowCount() : -1;
    return QStringLiteral("%1: box=%2 shared=%3 key=%4 name=%5 rows=%6")
        .arg(QLatin1String(side), text("txtCompPath"), card->compDir().toString(),
             card->accountKey().toString(), text("txtAccountName"))
        .arg(rows);
}

void print(const QString& line) {
    std::fputs(line.toUtf8().constData(), stdout);
    std::fputc('\n', stdout);
}

int selfTest(TwoCards& window, const QString& dir) {
    for (const char* name : {"demo.db", "demo2.db"}) {
        if (!QFileInfo(QDir(dir).filePath(QLatin1String(name))).isFile()) {
            std::fprintf(stderr, "no %s in %s (make it with ardcard-demo)\n", name,
                         dir.toLocal8Bit().constData());
            return 1;
        }
    }
    print(QStringLiteral("ardcard " ARDCARD_VERSION_STRING));
    try {
        window.open(dir);
        print(QStringLiteral("-- each card shows its own company"));
        print(describe("left", window.left));
        print(describe("right", window.right));

        // The left card sets the directories last: the right card's next
        // fetch reads the left card's company.
        window.left->setCompDir(QStringLiteral("demo.db"));
        window.right->findChild<QPushButton*>(QStringLiteral("ShowTransButt"))->click();
        print(QStringLiteral("-- the left card set the directories last"));
        print(describe("left", window.left));
        print(describe("right", window.right));
    } catch (const ardcard::Failure& failure) {
        std::fprintf(stderr, "failure: %s\n", failure.what());
        return 1;
    }
    std::fflush(stdout);
    return 0;
}

} // namespace

int main(int argc, char** argv) {
    // Page windows (statement, graph, information pages) need this before
    // the application object exists.
    ardcard::host::prepareWebEngine();
    QApplication app(argc, argv);
    const QStringList args = QApplication::arguments().mid(1);

    TwoCards window;
    window.resize(1800, 760);
    window.show();
    if (args.size() == 2 && args[0] == u"--self-test")
        return selfTest(window, QDir(args[1]).absolutePath());
    if (args.size() == 1)
        window.open(QDir(args[0]).absolutePath());
    return QApplication::exec();
}
