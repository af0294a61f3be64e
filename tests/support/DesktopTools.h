// What a user's desktop tools see on the test's X display: the active window,
// and a window asked to close through the window manager.
#pragma once

#include <string>
#include <sys/types.h>

// The window manager's active window, 0 when there is none.
unsigned long ActiveWindow();

// The id of process `pid`'s visible window titled exactly `title`, 0 if none.
unsigned long WindowOf(pid_t pid, const std::string& title);

// Asks the window manager to close the window, as its close box does.
void CloseWindow(unsigned long window);

class wxImage;
class wxRect;
class wxSize;

// What the screen shows in a rectangle of its pixels, on the test's display or another.
wxImage ScreenPixels(const wxRect& rect, const std::string& display = "");

// The size of the window itself, without the window manager's frame; (0, 0) if none.
wxSize WindowSize(unsigned long window);

// Whether two pictures of the same size match, each channel within `tolerance`.
bool SamePixels(const wxImage& a, const wxImage& b, int tolerance = 3);

// Minimises the window as its title bar's button does, through the window manager.
void MinimiseWindow(unsigned long window);

// True while the window is minimised (its WM_STATE is Iconic).
bool IsMinimised(unsigned long window);

// Where the window lies on the screen, in root coordinates; empty if it is gone.
wxRect WindowRect(unsigned long window);

// Activates the window and types `keys` (xdotool key names) through XTest.
void TypeKeys(unsigned long window, const std::string& keys);
