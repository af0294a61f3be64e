// Version information of the installed modules (Help > About Modules).
#pragma once

#include <wx/arrstr.h>

// The lines of a module's information window for its About Modules command id
// (1025-1030): name, "Version " and the product version or "N/A", legal lines.
// None for another id.
wxArrayString ModuleInfoLines(int commandId);

// Opens the information window for the About Modules command id.
void ShowModuleInfo(int commandId);
