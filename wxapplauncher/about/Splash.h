// Start-up splash screen and About box.
#pragma once

#include <wx/arrstr.h>

// Shows the start-up splash (startup true) or the About box for the given time.
void ShowSplash(bool startup, int milliseconds);

// The lines of the splash or About box, translated where they are meant to be;
// windowLineCount receives how many of them the text window shows at once.
wxArrayString SplashLines(bool startup, int& windowLineCount);
