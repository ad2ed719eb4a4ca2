#pragma once

#include "host/message_box.h"
#include "host/page_window.h"

#include <memory>
#include <vector>

namespace ardcard::app {

// A script driving the card on screen still wants to read back what the user
// saw: these seams keep a record and pass everything on to the real ones.
class RecordingMessageBox final : public host::MessageBoxSeam {
public:
    explicit RecordingMessageBox(host::MessageBoxSeam& next) : next_(next) {}
    void show(const QString& title, const QString& text, host::MessageIcon icon) override {
        record_.show(title, text, icon);
        next_.show(title, text, icon);
    }
    host::MessageRecorder& record() { return record_; }

private:
    host::MessageBoxSeam& next_;
    host::MessageRecorder record_;
};

class RecordingPageWindows final : public host::PageWindowFactory {
public:
    explicit RecordingPageWindows(host::PageWindowFactory& next) : next_(next) {}
    ~RecordingPageWindows() override;
    host::PageWindow* create() override;
    host::PageWindowRecorder& record() { return record_; }

private:
    host::PageWindowFactory& next_;
    host::PageWindowRecorder record_;
    std::vector<std::unique_ptr<host::PageWindow>> windows_;
};

} // namespace ardcard::app
