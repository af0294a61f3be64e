// A test's own connection to an X display: finds windows by title, reads the
// active window and asks a window to close, as a user's window manager would.
#pragma once

#include <string>

// Xlib's own header defines macros (None, Bool) that clash with other code.
struct _XDisplay;
using XWindowId = unsigned long;

class X11Client
{
public:
    explicit X11Client(const std::string& display = std::string());
    ~X11Client();
    X11Client(const X11Client&) = delete;
    X11Client& operator=(const X11Client&) = delete;

    bool IsOpen() const { return m_display != nullptr; }

    // A window with exactly this title (_NET_WM_NAME, else WM_NAME), or 0.
    XWindowId FindByTitle(const std::string& title);
    // The window manager's active window, or 0.
    XWindowId ActiveWindow();
    // Sends WM_DELETE_WINDOW, as the close box does.
    void RequestClose(XWindowId window);

private:
    _XDisplay* m_display;
};
