// The user guide, the help tool dialog and the suite's web pages.
#pragma once

#include <wx/string.h>

void OpenUserGuide();
void OpenUserForum();
void OpenHowTo();
void ShowHelpToolDialog(const wxString& appName, const wxString& page);
