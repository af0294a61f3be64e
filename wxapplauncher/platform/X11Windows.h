// Finding and activating another program's top-level window on an X11 display: GDK's
// own, or, when the launcher runs on Wayland, XWayland's through DISPLAY.
#pragma once

// Looks for a top-level window whose WM_CLASS class and title are exactly the
// given texts; raises, activates and focuses it. False when none is found or
// there is no X11 display.
bool BringWindowToFront(const char* windowClass, const char* title);

// True when the toolkit runs on an X11 display (XWayland included), where the
// window manager draws the decorations outside the window's size.
bool IsOnX11Display();
