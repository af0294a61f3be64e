// The help tool: shows, modally, where the help page of a window is expected
// and whether it is there.
#pragma once

#include <wx/string.h>

void ShowHelpToolDialog(const wxString& appName, const wxString& page);
