#pragma once

#include <QString>
#include <functional>

namespace ardcard::reports {

// The frame of the print, spreadsheet and graph commands: runs `write`,
// which writes every file of the command, then shows `pagePath` in a new
// page window (host::pageWindows()). When writing or showing fails, the
// user sees a message box with the failure's description, the critical icon
// and the title "תקלה", and no window opens; the writers have closed their
// files by then. Returns whether the page was shown.
bool RunOutputCommand(const std::function<void()>& write, const QString& pagePath);

// Tells the user that the graph has nothing to draw (information icon); the
// graph command shows this instead of opening a window on an old page.
void ReportNothingToDraw();

} // namespace ardcard::reports
