// Bringing another program's top-level window to the front.
#pragma once

// Looks for a top-level window whose window class and title are exactly the
// given texts (UTF-8); raises, activates and focuses it. False when none is
// found or the display offers no way to find one.
bool BringWindowToFront(const char* windowClass, const char* title);
