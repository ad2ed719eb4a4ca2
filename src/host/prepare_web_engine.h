#pragma once

namespace ardcard::host {

// WebEngine must be told before the QApplication exists that it shares GL
// contexts with the widgets, and Chromium refuses to run its sandbox as
// root. Call this first thing in main() of every program that may show a
// page window (the card's statement, graph and information pages), after
// choosing the platform: on the offscreen platform the GPU is left out as
// well, so that pages render where no display exists.
void prepareWebEngine();

} // namespace ardcard::host
