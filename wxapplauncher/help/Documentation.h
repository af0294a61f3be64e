// The user guide and the suite's web pages.
#pragma once

#include <wx/string.h>

void OpenUserGuide();
void OpenUserForum();
void OpenHowTo();
