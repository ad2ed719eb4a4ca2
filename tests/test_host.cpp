// The platform seams: the page-window sequence, the recorders a headless run
// prints through, and the built-in page window on a real WebEngine.

#include "common/failure.h"
#include "common/text_file_writer.h"
#include "host/builtin_page_window.h"
#include "host/hosting_page.h"
#include "host/message_box.h"
#include "host/page_window.h"
#include "host/seams.h"

#include <QAction>
#include <QApplication>
#include <QDesktopServices>
#include <QFile>
#include <QMainWindow>
#include <QMenuBar>
#include <QPointer>
#include <QSignalSpy>
#include <QTemporaryDir>
#include <QTest>
#include <QUrl>
#include <QWebEnginePage>
#include <QWebEngineView>
#include <cstdio>
#include <unistd.h>

using namespace ardcard;
using namespace ardcard::host;

namespace {

// Writes down every call a window receives, in order, so that the order of
// the show sequence can be read back.
class CallLog final : public PageWindowFactory {
public:
    QStringList calls;

    PageWindow* create() override {
        calls.append(QStringLiteral("create"));
        windows_.push_back(std::make_unique<Window>(calls));
        return windows_.back().get();
    }

private:
    class Window final : public PageWindow {
    public:
        explicit Window(QStringList& calls) : calls_(calls) {}
        void Navigate(const QString& path) override {
            calls_.append(QStringLiteral("Navigate ") + path);
        }
        void setFullScreen(bool on) override { log(QStringLiteral("FullScreen"), on); }
        void setMenuBar(bool on) override { log(QStringLiteral("MenuBar"), on); }
        void setAddressBar(bool on) override { log(QStringLiteral("AddressBar"), on); }
        void setVisible(bool on) override { log(QStringLiteral("Visible"), on); }

    private:
        void log(const QString& what, bool on) {
            calls_.append(what + (on ? QStringLiteral(" true") : QStringLiteral(" false")));
        }
        QStringList& calls_;
    };
    std::vector<std::unique_ptr<Window>> windows_;
};

// Everything written to stderr while it lives; read it with text().
class StderrCapture {
public:
    StderrCapture() {
        std::fflush(stderr);
        saved_ = ::dup(2);
        file_ = std::tmpfile();
        ::dup2(::fileno(file_), 2);
    }
    ~StderrCapture() { restore(); }
    QString text() {
        restore();
        std::rewind(file_);
        QByteArray bytes;
        char buffer[4096];
        size_t n;
        while ((n = std::fread(buffer, 1, sizeof buffer, file_)) > 0)
            bytes.append(buffer, static_cast<qsizetype>(n));
        return QString::fromUtf8(bytes);
    }

private:
    void restore() {
        if (saved_ < 0)
            return;
        std::fflush(stderr);
        ::dup2(saved_, 2);
        ::close(saved_);
        saved_ = -1;
    }
    int saved_ = -1;
    std::FILE* file_ = nullptr;
};

// Stands in for the desktop's handler of local files, so that following a
// link to a .csv file can be seen without starting a spreadsheet program.
class FileOpener : public QObject {
    Q_OBJECT
public:
    QList<QUrl> opened;
    Q_INVOKABLE void open(const QUrl& url) { opened.append(url); }
};

QWebEngineView* viewOf(QWidget* window) {
    return window ? window->findChild<QWebEngineView*>(QStringLiteral("pageView")) : nullptr;
}

QList<QMainWindow*> shownWindows() {
    QList<QMainWindow*> out;
    for (QWidget* w : QApplication::topLevelWidgets())
        if (w->objectName() == QStringLiteral("pageWindow"))
            out.append(qobject_cast<QMainWindow*>(w));
    return out;
}

QVariant runScript(QWebEnginePage* page, const QString& script) {
    QVariant result;
    bool done = false;
    page->runJavaScript(script, [&](const QVariant& value) {
        result = value;
        done = true;
    });
    if (!QTest::qWaitFor([&] { return done; }, 60000))
        return QStringLiteral("<no answer>");
    return result;
}

void writePage(const QString& path, const QStringList& lines) {
    TextFileWriter file(path, TextFileWriter::Unmappable::CharacterReference);
    for (const QString& line : lines)
        file.writeLine(line);
    file.close();
}

} // namespace

class TestHost : public QObject {
    Q_OBJECT
public:
    // Before QTEST_MAIN makes the application object.
    static void initMain() { prepareWebEngine(); }

private Q_SLOTS:
    void showPage_runsNavigateThenTheFourSettings();
    void recorder_keepsEachWindowsNavigationsInOrder();
    void recorder_echoesEachNavigation();
    void messageRecorder_keepsAndEchoesMessages_data();
    void messageRecorder_keepsAndEchoesMessages();
    void scopedSeams_restoresThePreviousSeams();
    void fixedHostingPage_readsMissingNamesAsEmpty();

    void builtIn_showsAWindows1255Page();
    void builtIn_secondNavigateReplacesThePageInTheSameWindow();
    void builtIn_csvLinkGoesToTheDesktop();
    void builtIn_navigateAfterTheUserClosedTheWindowFails();

    void cleanup();

private:
    QTemporaryDir dir_;
};

void TestHost::cleanup() {
    // Each test leaves its windows to the user; here the user closes them.
    for (QMainWindow* w : shownWindows())
        w->close();
    QTRY_VERIFY_WITH_TIMEOUT(shownWindows().isEmpty(), 10000);
}

void TestHost::showPage_runsNavigateThenTheFourSettings() {
    CallLog log;
    PageWindow* window = showPage(log, QStringLiteral("/tmp/vlprint.htm"));
    window->Navigate(QStringLiteral("/tmp/vlicrd1.htm"));
    const QStringList expected{
        QStringLiteral("create"),
        QStringLiteral("Navigate /tmp/vlprint.htm"),
        QStringLiteral("FullScreen false"),
        QStringLiteral("MenuBar true"),
        QStringLiteral("AddressBar false"),
        QStringLiteral("Visible true"),
        QStringLiteral("Navigate /tmp/vlicrd1.htm"),
    };
    QCOMPARE(log.calls, expected);
}

void TestHost::recorder_keepsEachWindowsNavigationsInOrder() {
    PageWindowRecorder recorder;
    PageWindow* first = showPage(recorder, QStringLiteral("/tmp/vlicrd0.htm"));
    showPage(recorder, QStringLiteral("/tmp/vlprint.htm"));
    first->Navigate(QStringLiteral("/tmp/vlicrd1.htm"));

    const QList<QStringList> expected{
        {QStringLiteral("/tmp/vlicrd0.htm"), QStringLiteral("/tmp/vlicrd1.htm")},
        {QStringLiteral("/tmp/vlprint.htm")},
    };
    QCOMPARE(recorder.windows(), expected);

    recorder.clear();
    QVERIFY(recorder.windows().isEmpty());
    showPage(recorder, QStringLiteral("/tmp/vtransg.htm"));
    QCOMPARE(recorder.windows(), QList<QStringList>{{QStringLiteral("/tmp/vtransg.htm")}});
}

void TestHost::recorder_echoesEachNavigation() {
    StderrCapture capture;
    {
        PageWindowRecorder recorder(true);
        PageWindow* first = showPage(recorder, QStringLiteral("/tmp/vlinf0.htm"));
        showPage(recorder, QStringLiteral("/tmp/קובץ.htm"));
        first->Navigate(QStringLiteral("/tmp/vlinf1.htm"));
    }
    QCOMPARE(capture.text(), QStringLiteral("navigate: 1: /tmp/vlinf0.htm\n"
                                            "navigate: 2: /tmp/קובץ.htm\n"
                                            "navigate: 1: /tmp/vlinf1.htm\n"));
}

void TestHost::messageRecorder_keepsAndEchoesMessages_data() {
    QTest::addColumn<int>("icon");
    QTest::addColumn<QString>("title");
    QTest::addColumn<QString>("text");
    QTest::addColumn<QString>("line");

    QTest::newRow("critical") << int(MessageIcon::Critical) << QStringLiteral("תקלה")
                              << QStringLiteral("לא נמצא חשבון")
                              << QStringLiteral("message: critical: תקלה: לא נמצא חשבון\n");
    QTest::newRow("information") << int(MessageIcon::Information) << QStringLiteral("הודעה")
                                 << QStringLiteral("החיבור תקין")
                                 << QStringLiteral("message: information: הודעה: החיבור תקין\n");
    QTest::newRow("empty title") << int(MessageIcon::Critical) << QString() << QStringLiteral("x")
                                 << QStringLiteral("message: critical: : x\n");
}

void TestHost::messageRecorder_keepsAndEchoesMessages() {
    QFETCH(int, icon);
    QFETCH(QString, title);
    QFETCH(QString, text);
    QFETCH(QString, line);

    StderrCapture capture;
    MessageRecorder echoing(true);
    echoing.show(title, text, MessageIcon(icon));
    QCOMPARE(capture.text(), line);

    MessageRecorder silent;
    StderrCapture quiet;
    silent.show(title, text, MessageIcon(icon));
    silent.show(QStringLiteral("שנייה"), QStringLiteral("ב"), MessageIcon::Information);
    QCOMPARE(quiet.text(), QString());
    QCOMPARE(silent.messages().size(), 2);
    QCOMPARE(int(silent.messages()[0].icon), icon);
    QCOMPARE(silent.messages()[0].title, title);
    QCOMPARE(silent.messages()[0].text, text);
    QCOMPARE(silent.messages()[1].title, QStringLiteral("שנייה"));
    silent.clear();
    QVERIFY(silent.messages().isEmpty());
}

void TestHost::scopedSeams_restoresThePreviousSeams() {
    MessageRecorder outer;
    PageWindowRecorder outerWindows;
    ScopedSeams a(&outer, &outerWindows);
    {
        MessageRecorder inner;
        PageWindowRecorder innerWindows;
        ScopedSeams b(&inner, &innerWindows);
        messageBox().show(QStringLiteral("t"), QStringLiteral("inner"), MessageIcon::Critical);
        showPage(host::pageWindows(), QStringLiteral("/tmp/a.htm"));
        QCOMPARE(inner.messages().size(), 1);
        QCOMPARE(innerWindows.windows().size(), 1);
    }
    messageBox().show(QStringLiteral("t"), QStringLiteral("outer"), MessageIcon::Information);
    QCOMPARE(outer.messages().size(), 1);
    QCOMPARE(outer.messages()[0].text, QStringLiteral("outer"));
    QVERIFY(outerWindows.windows().isEmpty());
}

void TestHost::fixedHostingPage_readsMissingNamesAsEmpty() {
    FixedHostingPage page(QStringLiteral("file:///c/card.htm#demo.db"),
                          {{QStringLiteral("AServer"), QStringLiteral("/data")}});
    QCOMPARE(page.address(), QStringLiteral("file:///c/card.htm#demo.db"));
    QCOMPARE(page.value(QStringLiteral("AServer")), QStringLiteral("/data"));
    QCOMPARE(page.value(QStringLiteral("AUID")), QString());
    page.setValue(QStringLiteral("AUID"), QStringLiteral("sa"));
    QCOMPARE(page.value(QStringLiteral("AUID")), QStringLiteral("sa"));
}

void TestHost::builtIn_showsAWindows1255Page() {
    QVERIFY(dir_.isValid());
    const QString path = dir_.filePath(QStringLiteral("vlprint.htm"));
    writePage(path, {
                        QStringLiteral("<HTML dir='rtl'>"),
                        QStringLiteral("<HEAD>"),
                        QStringLiteral("<meta http-equiv='Content-Type' content='text/html; "
                                       "charset=windows-1255'>"),
                        QStringLiteral("<TITLE>ולמור מערכות מידע מציגה</TITLE>"),
                        QStringLiteral("</HEAD>"),
                        QStringLiteral("<BODY>כרטסת חשבון 1001</BODY>"),
                        QStringLiteral("</HTML>"),
                    });
    // The file really is in the single-byte code page: alef is 0xE0 there.
    QFile raw(path);
    QVERIFY(raw.open(QIODevice::ReadOnly));
    QVERIFY(raw.readAll().contains("\xeb\xf8\xe8\xf1\xfa")); // "כרטסת"

    BuiltInPageWindowFactory factory;
    PageWindow* window = showPage(factory, path);
    const QList<QMainWindow*> shown = shownWindows();
    QCOMPARE(shown.size(), 1);
    QMainWindow* main = shown.first();
    QVERIFY(main->isVisible());
    QVERIFY(!main->isFullScreen());
    QVERIFY(main->menuBar()->isVisible());
    QVERIFY(main->testAttribute(Qt::WA_DeleteOnClose));
    QWebEngineView* view = viewOf(main);
    QVERIFY(view);

    QTRY_COMPARE_WITH_TIMEOUT(view->url(), QUrl::fromLocalFile(path), 60000);
    QTRY_COMPARE_WITH_TIMEOUT(view->title(), QStringLiteral("ולמור מערכות מידע מציגה"), 60000);
    QCOMPARE(runScript(view->page(), QStringLiteral("document.body.innerText")).toString(),
             QStringLiteral("כרטסת חשבון 1001"));
    QCOMPARE(main->windowTitle(), QStringLiteral("ולמור מערכות מידע מציגה"));

    // The menu the user prints and saves with.
    QStringList captions;
    for (QAction* action : main->findChildren<QAction*>())
        captions.append(action->text());
    for (const QString& caption : {QStringLiteral("הדפסה..."), QStringLiteral("שמירה כ-PDF..."),
                                   QStringLiteral("פתיחה בדפדפן"), QStringLiteral("סגירה")})
        QVERIFY2(captions.contains(caption), qPrintable(caption));

    window->setMenuBar(false);
    QVERIFY(!main->menuBar()->isVisible());
}

void TestHost::builtIn_secondNavigateReplacesThePageInTheSameWindow() {
    const QString wait = dir_.filePath(QStringLiteral("vlicrd0.htm"));
    const QString page = dir_.filePath(QStringLiteral("vlicrd1.htm"));
    const QString charset = QStringLiteral(
        "<meta http-equiv='Content-Type' content='text/html; charset=windows-1255'>");
    writePage(wait, {QStringLiteral("<HTML><HEAD><TITLE>אנא המתן</TITLE>"), charset,
                     QStringLiteral("</HEAD><BODY>אנא המתן</BODY></HTML>")});
    writePage(page, {QStringLiteral("<HTML><HEAD><TITLE>כרטיס חשבון</TITLE>"), charset,
                     QStringLiteral("</HEAD><BODY>לקוח ראשון</BODY></HTML>")});

    BuiltInPageWindowFactory factory;
    PageWindow* window = showPage(factory, wait);
    QWebEngineView* view = viewOf(shownWindows().value(0));
    QVERIFY(view);
    QTRY_COMPARE_WITH_TIMEOUT(view->title(), QStringLiteral("אנא המתן"), 60000);

    window->Navigate(page);
    QTRY_COMPARE_WITH_TIMEOUT(view->title(), QStringLiteral("כרטיס חשבון"), 60000);
    QCOMPARE(view->url(), QUrl::fromLocalFile(page));
    QCOMPARE(runScript(view->page(), QStringLiteral("document.body.innerText")).toString(),
             QStringLiteral("לקוח ראשון"));
    QCOMPARE(shownWindows().size(), 1);

    // The next command gets a window of its own.
    showPage(factory, wait);
    QCOMPARE(shownWindows().size(), 2);
}

void TestHost::builtIn_csvLinkGoesToTheDesktop() {
    const QString csv = dir_.filePath(QStringLiteral("vltrans1.csv"));
    const QString page = dir_.filePath(QStringLiteral("vltrans1.htm"));
    {
        TextFileWriter file(csv, TextFileWriter::Unmappable::QuestionMark);
        file.writeLine(QStringLiteral("תאריך,סכום"));
        file.close();
    }
    // Like the spreadsheet page: no character-set line, the link is the path
    // as written.
    writePage(page, {QStringLiteral("<HTML><HEAD><TITLE>גיליון</TITLE></HEAD><BODY>"),
                     QStringLiteral("<A id='csv' HREF='") + csv + QStringLiteral("'>לחץ כאן</A>"),
                     QStringLiteral("</BODY></HTML>")});

    FileOpener opener;
    QDesktopServices::setUrlHandler(QStringLiteral("file"), &opener, "open");
    BuiltInPageWindowFactory factory;
    showPage(factory, page);
    QWebEngineView* view = viewOf(shownWindows().value(0));
    QVERIFY(view);
    QTRY_COMPARE_WITH_TIMEOUT(view->title(), QStringLiteral("גיליון"), 60000);
    // The page has no character-set line and still reads as Hebrew.
    QCOMPARE(runScript(view->page(), QStringLiteral("document.body.innerText")).toString(),
             QStringLiteral("לחץ כאן"));

    runScript(view->page(), QStringLiteral("document.getElementById('csv').click(); 1"));
    QTRY_COMPARE_WITH_TIMEOUT(opener.opened.size(), 1, 60000);
    QDesktopServices::unsetUrlHandler(QStringLiteral("file"));
    QCOMPARE(opener.opened.first(), QUrl::fromLocalFile(csv));
    // The page stays where it was.
    QCOMPARE(view->url(), QUrl::fromLocalFile(page));
}

void TestHost::builtIn_navigateAfterTheUserClosedTheWindowFails() {
    const QString wait = dir_.filePath(QStringLiteral("wait.htm"));
    writePage(wait, {QStringLiteral("<HTML><BODY>1</BODY></HTML>")});
    BuiltInPageWindowFactory factory;
    PageWindow* window = showPage(factory, wait);
    QPointer<QMainWindow> main = shownWindows().value(0);
    QVERIFY(main);
    main->close();
    QTRY_VERIFY_WITH_TIMEOUT(main.isNull(), 10000);
    QVERIFY_THROWS_EXCEPTION(Failure, window->Navigate(wait));
}

QTEST_MAIN(TestHost)
#include "test_host.moc"
