// Finding and activating another program's top-level window on an X11 display.
#pragma once

// Looks for a top-level window whose WM_CLASS class and title are exactly the
// given texts; raises, activates and focuses it. False when none is found or
// the display is not X11.
bool BringWindowToFront(const char* windowClass, const char* title);
