// Keyboard focus for windows that draw themselves and take no text: no input
// method for them, and whether the desktop wants the focus shown.
#pragma once

class wxWindow;

// Drops the input method the toolkit gives the window. Call it once the
// window is created (wxEVT_CREATE). GTK's X input method (the default for
// Japanese, Chinese, Korean and Thai) asks for the X window of the focused
// window, which turns a client-side GDK window into a native child window, and
// what the launcher paints there never reaches the screen.
void DropInputMethod(wxWindow* window);

// True once the window's top-level window shows the keyboard focus: the
// desktop turns this on with the first key press, so a mouse user sees no
// focus mark.
bool IsFocusShown(const wxWindow* window);
