#include "help/Documentation.h"

// Not built yet: these commands do nothing.
void OpenUserGuide() {}
void OpenUserForum() {}
void OpenHowTo() {}
