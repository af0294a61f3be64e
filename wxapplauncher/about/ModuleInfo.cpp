#include "about/ModuleInfo.h"

// The module information window is not built yet.
void ShowModuleInfo(int) {}
