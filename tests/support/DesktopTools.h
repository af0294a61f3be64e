// What a user's desktop tools see and do on the test's X display, through the
// window manager as its title bar's buttons do.
#pragma once

#include <string>
#include <sys/types.h>

class wxImage;
class wxRect;

// The window manager's active window, 0 when there is none.
unsigned long ActiveWindow();
// The id of process `pid`'s visible window titled exactly `title`, 0 if none.
unsigned long WindowOf(pid_t pid, const std::string& title);
// The window's title as the X server holds it (_NET_WM_NAME, else WM_NAME).
std::string WindowTitle(unsigned long window);
void CloseWindow(unsigned long window);
void MinimiseWindow(unsigned long window);
bool IsMinimised(unsigned long window);
// Where the window itself (without the window manager's frame) lies on the
// screen, in root coordinates; empty if it is gone.
wxRect WindowRect(unsigned long window);
// Activates the window and types `keys` (xdotool key names) through XTest.
void TypeKeys(unsigned long window, const std::string& keys);

// The clipboard's text as another program reads it; empty when nobody holds it.
std::string ClipboardText();

// What the screen shows in a rectangle of its pixels, on the test's display or another.
wxImage ScreenPixels(const wxRect& rect, const std::string& display = "");
// Whether two pictures of the same size match, each channel within `tolerance`.
bool SamePixels(const wxImage& a, const wxImage& b, int tolerance = 3);
