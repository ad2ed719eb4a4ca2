#include "recording_seams.h"

namespace ardcard::app {

namespace {

class RecordingWindow final : public host::PageWindow {
public:
    RecordingWindow(host::PageWindow* record, host::PageWindow* shown)
        : record_(record), shown_(shown) {}
    void Navigate(const QString& path) override {
        record_->Navigate(path);
        shown_->Navigate(path);
    }
    void setFullScreen(bool on) override { shown_->setFullScreen(on); }
    void setMenuBar(bool on) override { shown_->setMenuBar(on); }
    void setAddressBar(bool on) override { shown_->setAddressBar(on); }
    void setVisible(bool on) override { shown_->setVisible(on); }

private:
    host::PageWindow* record_;
    host::PageWindow* shown_;
};

} // namespace

RecordingPageWindows::~RecordingPageWindows() = default;

host::PageWindow* RecordingPageWindows::create() {
    host::PageWindow* shown = next_.create();
    windows_.push_back(std::make_unique<RecordingWindow>(record_.create(), shown));
    return windows_.back().get();
}

} // namespace ardcard::app
