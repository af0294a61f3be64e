// The user's interface language, decided once at start-up and used everywhere it
// matters: the catalogues, Verify's language number and the help folder.
#pragma once

#include <wx/intl.h>
#include <wx/string.h>

// Takes the decision from what the system says (on Linux the environment: LC_ALL,
// LC_MESSAGES, LANG) and keeps it for the run. A locale that is not installed
// still counts: "de_XX" is German.
void DecideUserLanguage();

// The decided language's toolkit value; wxLANGUAGE_UNKNOWN when none is known.
// Before start-up decided, both ask the system afresh.
wxLanguage GetUserLanguage();

// The canonical name of the user's language ("de_DE", "ja", "pt_BR"); empty when unknown.
wxString GetUserLanguageName();

// True when the system has the user's locale installed, so the C library can use it.
bool IsUserLocaleInstalled();
