#pragma once

#include "host/page_window.h"

namespace ardcard::host {

// The built-in page viewer: a window on Qt WebEngine with a menu bar
// (Print..., Save as PDF..., Open in browser, Close), no address bar. A
// second Navigate replaces the page in the same window; a link to a .csv
// file opens with the desktop's spreadsheet program. The window deletes
// itself when the user closes it.
class BuiltInPageWindowFactory final : public PageWindowFactory {
public:
    PageWindow* create() override;
};

} // namespace ardcard::host
