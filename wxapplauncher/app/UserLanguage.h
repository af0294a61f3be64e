// The user's interface language, decided once at start-up and used everywhere it
// matters: the catalogues, Verify's language number and the help folder.
#pragma once

#include <wx/string.h>

// The canonical name of the user's language ("de_DE", "ja", "pt_BR"); empty when unknown.
wxString GetUserLanguageName();
