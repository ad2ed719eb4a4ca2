#pragma once

#include "host/page_window.h"
#include "host/prepare_web_engine.h"

#include <memory>
#include <vector>

namespace ardcard::host {

// The built-in page viewer: a window on Qt WebEngine with a menu bar
// (Print..., Save as PDF..., Open in browser, Close), no address bar. A
// second Navigate replaces the page in the same window; a link to a .csv
// file opens with the desktop's spreadsheet program. The window deletes
// itself when the user closes it; the system never closes one.
//
// The window's object name is "pageWindow" and its view's "pageView", so
// that a test or a script can find what the user sees.
class BuiltInPageWindowFactory final : public PageWindowFactory {
public:
    BuiltInPageWindowFactory();
    ~BuiltInPageWindowFactory() override;
    // Needs a QApplication made after prepareWebEngine(); throws Failure
    // without one.
    PageWindow* create() override;

private:
    // The handles the callers hold; each is small and stays valid after the
    // user has closed its window.
    std::vector<std::unique_ptr<PageWindow>> handles_;
};

} // namespace ardcard::host
