// Start-up splash screen and About box.
#pragma once

// Shows the start-up splash (startup true) or the About box for the given time.
void ShowSplash(bool startup, int milliseconds);
