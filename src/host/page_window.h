#pragma once

#include <QList>
#include <QString>
#include <QStringList>

namespace ardcard::host {

// One window of the platform's page viewer. The system creates one per
// command, navigates it and never closes it: once shown it belongs to the
// user (implementations own themselves).
class PageWindow {
public:
    virtual ~PageWindow() = default;
    virtual void Navigate(const QString& path) = 0;
    virtual void setFullScreen(bool on) = 0;
    virtual void setMenuBar(bool on) = 0;
    virtual void setAddressBar(bool on) = 0;
    virtual void setVisible(bool on) = 0;
};

class PageWindowFactory {
public:
    virtual ~PageWindowFactory() = default;
    // A new window; throws Failure when none can be made.
    virtual PageWindow* create() = 0;
};

// Shows a finished page file: a new window, Navigate, then FullScreen false,
// MenuBar true, AddressBar false, Visible true, in this order. The window is
// returned so that a caller may navigate it once more (the wait page).
PageWindow* showPage(PageWindowFactory& factory, const QString& path);

// Records windows instead of showing them: windows()[n] lists the paths that
// window n navigated to. With echo on, each navigation prints
// "navigate: <window number from 1>: <path>" to stderr.
class PageWindowRecorder final : public PageWindowFactory {
public:
    explicit PageWindowRecorder(bool echo = false) : echo_(echo) {}
    ~PageWindowRecorder() override;
    PageWindow* create() override;
    QList<QStringList> windows() const;
    void clear();

private:
    class Window;
    QList<Window*> windows_;
    bool echo_;
};

// The desktop's default browser through QDesktopServices: each navigation
// opens the file there (the settings have no meaning for it).
class DesktopBrowserFactory final : public PageWindowFactory {
public:
    PageWindow* create() override;
};

} // namespace ardcard::host
