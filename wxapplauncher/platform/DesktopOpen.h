// Handing a file or a web address to the desktop, which opens it with the
// program the user chose for its type.
#pragma once

#include <wx/string.h>

#include <functional>

// Starts the desktop's opener with `target`. `onFailure`, when given, runs on
// the GUI thread if the opener cannot be started or reports that nothing
// opens the target (for example when no program opens that type).
void OpenWithDesktop(const wxString& target, std::function<void()> onFailure = {});
