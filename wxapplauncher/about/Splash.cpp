#include "about/Splash.h"

// The splash and About windows are not built yet; start-up keeps its timing without them.
void ShowSplash(bool, int) {}
