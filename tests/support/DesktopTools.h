// What a user's desktop tools see and do on the test's X display, through the
// window manager as its title bar's buttons do.
#pragma once

#include <string>
#include <sys/types.h>

class wxImage;
class wxRect;
class wxSize;

// The window manager's active window, 0 when there is none.
unsigned long ActiveWindow();
// The id of process `pid`'s visible window titled exactly `title`, 0 if none.
unsigned long WindowOf(pid_t pid, const std::string& title);
void CloseWindow(unsigned long window);
void MinimiseWindow(unsigned long window);
bool IsMinimised(unsigned long window);
// The size of the window itself, without the window manager's frame; (0, 0) if none.
wxSize WindowSize(unsigned long window);
// What the screen shows in a rectangle given in screen coordinates.
wxImage ScreenPixels(const wxRect& rect);
