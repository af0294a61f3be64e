#include "help/HelpTool.h"

// Not built yet: the command does nothing.
void ShowHelpToolDialog(const wxString&, const wxString&) {}
