#pragma once

#include "host/message_box.h"
#include "host/page_window.h"

namespace ardcard::host {

// The platform services in force on the calling thread. By default the GUI
// message box and the built-in page window; the headless host and the tests
// install recorders. The seams are borrowed: whoever installs them keeps
// them alive while they are in force.
struct Seams {
    MessageBoxSeam* messages = nullptr;
    PageWindowFactory* windows = nullptr;
};

Seams& seams();
MessageBoxSeam& messageBox();
PageWindowFactory& pageWindows();

// Installs seams for the life of the object and restores the previous ones.
class ScopedSeams {
public:
    ScopedSeams(MessageBoxSeam* messages, PageWindowFactory* windows);
    ~ScopedSeams();
    ScopedSeams(const ScopedSeams&) = delete;
    ScopedSeams& operator=(const ScopedSeams&) = delete;

private:
    Seams previous_;
};

} // namespace ardcard::host
