// Handing a file or a web address to the desktop, which opens it with the
// program the user chose for its type (xdg-open).
#pragma once

#include <wx/string.h>

#include <functional>

// Starts the desktop's opener with `target` as its one argument. `onFailure`,
// when given, runs on the GUI thread if the opener cannot be started or ends
// with a failure status (for example when no program opens that type).
void OpenWithDesktop(const wxString& target, std::function<void()> onFailure = {});
