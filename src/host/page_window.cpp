#include "host/page_window.h"

#include <QDesktopServices>
#include <QUrl>
#include <cstdio>
#include <memory>
#include <vector>

namespace ardcard::host {

PageWindow* showPage(PageWindowFactory& factory, const QString& path) {
    PageWindow* window = factory.create();
    window->Navigate(path);
    window->setFullScreen(false);
    window->setMenuBar(true);
    window->setAddressBar(false);
    window->setVisible(true);
    return window;
}

class PageWindowRecorder::Window final : public PageWindow {
public:
    Window(int number, bool echo) : number_(number), echo_(echo) {}
    void Navigate(const QString& path) override {
        paths.append(path);
        if (echo_) {
            std::fprintf(stderr, "navigate: %d: %s\n", number_, path.toUtf8().constData());
            std::fflush(stderr);
        }
    }
    void setFullScreen(bool) override {}
    void setMenuBar(bool) override {}
    void setAddressBar(bool) override {}
    void setVisible(bool) override {}

    QStringList paths;

private:
    int number_;
    bool echo_;
};

PageWindowRecorder::~PageWindowRecorder() {
    qDeleteAll(windows_);
}

PageWindow* PageWindowRecorder::create() {
    auto* window = new Window(static_cast<int>(windows_.size()) + 1, echo_);
    windows_.append(window);
    return window;
}

QList<QStringList> PageWindowRecorder::windows() const {
    QList<QStringList> out;
    for (const Window* w : windows_)
        out.append(w->paths);
    return out;
}

void PageWindowRecorder::clear() {
    qDeleteAll(windows_);
    windows_.clear();
}

namespace {
// The desktop browser keeps its own windows; this object only forwards the
// navigations, and lives for the rest of the run like the windows it opened.
class DesktopBrowserWindow final : public PageWindow {
public:
    void Navigate(const QString& path) override {
        QDesktopServices::openUrl(QUrl::fromLocalFile(path));
    }
    void setFullScreen(bool) override {}
    void setMenuBar(bool) override {}
    void setAddressBar(bool) override {}
    void setVisible(bool) override {}
};
} // namespace

PageWindow* DesktopBrowserFactory::create() {
    thread_local std::vector<std::unique_ptr<DesktopBrowserWindow>> windows;
    windows.push_back(std::make_unique<DesktopBrowserWindow>());
    return windows.back().get();
}

} // namespace ardcard::host
