#include "host/seams.h"

#include "host/builtin_page_window.h"

namespace ardcard::host {

Seams& seams() {
    thread_local Seams current;
    return current;
}

MessageBoxSeam& messageBox() {
    Seams& s = seams();
    if (!s.messages) {
        thread_local GuiMessageBox gui;
        s.messages = &gui;
    }
    return *s.messages;
}

PageWindowFactory& pageWindows() {
    Seams& s = seams();
    if (!s.windows) {
        thread_local BuiltInPageWindowFactory builtIn;
        s.windows = &builtIn;
    }
    return *s.windows;
}

ScopedSeams::ScopedSeams(MessageBoxSeam* messages, PageWindowFactory* windows)
    : previous_(seams()) {
    seams().messages = messages;
    seams().windows = windows;
}

ScopedSeams::~ScopedSeams() {
    seams() = previous_;
}

} // namespace ardcard::host
