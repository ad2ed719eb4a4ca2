#include "host/builtin_page_window.h"

#include "common/failure.h"
#include "host/seams.h"

#include <QAction>
#include <QApplication>
#include <QDesktopServices>
#include <QDir>
#include <QFileDialog>
#include <QFileInfo>
#include <QMainWindow>
#include <QMenu>
#include <QMenuBar>
#include <QPointer>
#include <QPrintDialog>
#include <QPrinter>
#include <QStandardPaths>
#include <QUrl>
#include <QWebEnginePage>
#include <QWebEngineSettings>
#include <QWebEngineView>
#include <memory>
#include <unistd.h>

namespace ardcard::host {

namespace {

// A page path as the callers give it is a local file; a text that already
// names a scheme (two letters or more, so that a drive letter is not taken
// for one) is used as an address.
QUrl pageUrl(const QString& path) {
    QUrl url(path);
    if (!url.isRelative() && url.scheme().size() > 1)
        return url;
    return QUrl::fromLocalFile(QFileInfo(path).absoluteFilePath());
}

bool isCsvFile(const QUrl& url) {
    return url.isLocalFile() && url.path().endsWith(QStringLiteral(".csv"), Qt::CaseInsensitive);
}

void showFailure(const QString& text) {
    messageBox().show(QStringLiteral("תקלה"), text, MessageIcon::Critical);
}

class PageViewWindow;

// The page inside a window. The spreadsheet page links to the exported
// file: the clerk expects the spreadsheet program, not the text in the
// browser or a download, so such links go to the desktop.
class PageContent final : public QWebEnginePage {
public:
    explicit PageContent(QObject* parent) : QWebEnginePage(parent) {}

protected:
    bool acceptNavigationRequest(const QUrl& url, NavigationType type, bool isMainFrame) override {
        if (isCsvFile(url)) {
            QDesktopServices::openUrl(url);
            return false;
        }
        return QWebEnginePage::acceptNavigationRequest(url, type, isMainFrame);
    }

    // A page that opens a window of its own gets another window like this
    // one.
    QWebEnginePage* createWindow(WebWindowType type) override;
};

class PageViewWindow final : public QMainWindow {
public:
    PageViewWindow() {
        setObjectName(QStringLiteral("pageWindow"));
        setAttribute(Qt::WA_DeleteOnClose);
        setLayoutDirection(Qt::RightToLeft);

        view_ = new QWebEngineView(this);
        view_->setObjectName(QStringLiteral("pageView"));
        view_->setPage(new PageContent(view_));
        // Pages written without a character-set line (the spreadsheet page)
        // are in the same code page as every other page of the system.
        view_->settings()->setDefaultTextEncoding(QStringLiteral("windows-1255"));
        setCentralWidget(view_);
        buildMenu();

        connect(view_, &QWebEngineView::titleChanged, this, &PageViewWindow::showTitle);
        connect(view_, &QWebEngineView::printRequested, this, &PageViewWindow::print);
        connect(view_, &QWebEngineView::printFinished, this, &PageViewWindow::printDone);
        connect(view_, &QWebEngineView::pdfPrintingFinished, this, &PageViewWindow::pdfDone);
        resize(960, 720);
    }

    ~PageViewWindow() override {
        // A print in progress still writes to the printer: the view goes
        // first, the printer after it.
        delete view_;
    }

    QWebEnginePage* page() const { return view_->page(); }

    void navigate(const QString& path) {
        path_ = path;
        const QUrl url = pageUrl(path);
        if (windowTitle().isEmpty())
            setWindowTitle(url.fileName());
        view_->load(url);
    }

    void setFullScreenState(bool on) {
        setWindowState(on ? windowState() | Qt::WindowFullScreen
                          : windowState() & ~Qt::WindowFullScreen);
    }

    void setMenuBarShown(bool on) { menuBar()->setVisible(on); }

    void setShown(bool on) {
        setVisible(on);
        if (on) {
            raise();
            activateWindow();
        }
    }

private:
    void buildMenu() {
        QMenu* file = menuBar()->addMenu(QStringLiteral("&קובץ"));
        QAction* print = file->addAction(QStringLiteral("הדפסה..."), this, &PageViewWindow::print);
        print->setShortcut(QKeySequence::Print);
        QAction* pdf =
            file->addAction(QStringLiteral("שמירה כ-PDF..."), this, &PageViewWindow::saveAsPdf);
        pdf->setShortcut(QKeySequence::Save);
        file->addAction(QStringLiteral("פתיחה בדפדפן"), this, &PageViewWindow::openInBrowser);
        file->addSeparator();
        QAction* close = file->addAction(QStringLiteral("סגירה"), this, &QWidget::close);
        close->setShortcut(QKeySequence::Close);
    }

    void showTitle(const QString& title) {
        if (!title.isEmpty())
            setWindowTitle(title);
    }

    QUrl currentUrl() const {
        const QUrl shown = view_->url();
        return shown.isValid() && !shown.isEmpty() ? shown : pageUrl(path_);
    }

    void print() {
        if (printer_) // the engine prints one job at a time
            return;
        auto printer = std::make_unique<QPrinter>(QPrinter::HighResolution);
        QPrintDialog dialog(printer.get(), this);
        dialog.setLayoutDirection(Qt::RightToLeft);
        if (dialog.exec() != QDialog::Accepted)
            return;
        printer_ = std::move(printer);
        view_->print(printer_.get());
    }

    void printDone(bool ok) {
        printer_.reset();
        if (!ok)
            showFailure(QStringLiteral("ההדפסה נכשלה"));
    }

    void saveAsPdf() {
        const QString documents =
            QStandardPaths::writableLocation(QStandardPaths::DocumentsLocation);
        QString base = currentUrl().fileName();
        base =
            base.left(base.lastIndexOf(u'.')).isEmpty() ? base : base.left(base.lastIndexOf(u'.'));
        QString path =
            QFileDialog::getSaveFileName(this, QStringLiteral("שמירה כ-PDF"),
                                         QDir(documents.isEmpty() ? QDir::homePath() : documents)
                                             .filePath(base + QStringLiteral(".pdf")),
                                         QStringLiteral("PDF (*.pdf)"));
        if (path.isEmpty())
            return;
        if (!path.endsWith(QStringLiteral(".pdf"), Qt::CaseInsensitive))
            path += QStringLiteral(".pdf");
        view_->printToPdf(path);
    }

    void pdfDone(const QString& path, bool ok) {
        if (!ok)
            showFailure(QStringLiteral("השמירה כ-PDF נכשלה: ") + QDir::toNativeSeparators(path));
    }

    void openInBrowser() { QDesktopServices::openUrl(currentUrl()); }

    QWebEngineView* view_ = nullptr;
    QString path_;
    std::unique_ptr<QPrinter> printer_;
};

QWebEnginePage* PageContent::createWindow(WebWindowType) {
    auto* window = new PageViewWindow;
    window->show();
    return window->page();
}

// What the system holds: a handle that outlives the window, because the
// user may close the window while a caller still has it (a second
// navigation then fails to that caller instead of touching a deleted
// window).
class BuiltInPageWindow final : public PageWindow {
public:
    BuiltInPageWindow() : window_(new PageViewWindow) {}

    void Navigate(const QString& path) override { window().navigate(path); }
    void setFullScreen(bool on) override { window().setFullScreenState(on); }
    void setMenuBar(bool on) override { window().setMenuBarShown(on); }
    // The window has no address bar to show or hide.
    void setAddressBar(bool) override { window(); }
    void setVisible(bool on) override { window().setShown(on); }

private:
    PageViewWindow& window() {
        if (!window_)
            throw Failure(QStringLiteral("חלון הדף נסגר"));
        return *window_;
    }

    QPointer<PageViewWindow> window_;
};

void appendChromiumFlag(QByteArray& flags, const QByteArray& flag) {
    if (flags.contains(flag))
        return;
    if (!flags.isEmpty())
        flags += ' ';
    flags += flag;
}

} // namespace

BuiltInPageWindowFactory::BuiltInPageWindowFactory() = default;
BuiltInPageWindowFactory::~BuiltInPageWindowFactory() = default;

PageWindow* BuiltInPageWindowFactory::create() {
    if (!qobject_cast<QApplication*>(QCoreApplication::instance()))
        throw Failure(QStringLiteral("אין אפשרות להציג דפים בהפעלה זו"));
    handles_.push_back(std::make_unique<BuiltInPageWindow>());
    return handles_.back().get();
}

void prepareWebEngine() {
    QCoreApplication::setAttribute(Qt::AA_ShareOpenGLContexts);
    QByteArray flags = qgetenv("QTWEBENGINE_CHROMIUM_FLAGS");
    if (::geteuid() == 0) {
        qputenv("QTWEBENGINE_DISABLE_SANDBOX", "1");
        appendChromiumFlag(flags, "--no-sandbox");
    }
    if (qgetenv("QT_QPA_PLATFORM") == "offscreen")
        appendChromiumFlag(flags, "--disable-gpu");
    if (!flags.isEmpty())
        qputenv("QTWEBENGINE_CHROMIUM_FLAGS", flags);
}

} // namespace ardcard::host
