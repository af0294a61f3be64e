// A desktop's clipboard manager on the test's X display, as the freedesktop protocol
// has it: it owns CLIPBOARD_MANAGER and, asked by a program to save the clipboard
// (SAVE_TARGETS), takes the clipboard's text and from then on serves it itself.
#pragma once

#include <thread>

struct _XDisplay;

class ClipboardManager
{
public:
    ClipboardManager();
    ~ClipboardManager();
    ClipboardManager(const ClipboardManager&) = delete;
    ClipboardManager& operator=(const ClipboardManager&) = delete;

    // Whether it took the manager's selection.
    bool Running() const { return m_running; }

private:
    void Serve();

    _XDisplay* m_display = nullptr;
    unsigned long m_window = 0;
    bool m_running = false;
    int m_wake[2] = {-1, -1};
    std::thread m_thread;
};
