// The language folder of the installed help pages.
#pragma once

#include <wx/string.h>

// The two-letter folder for a language's canonical name ("de_DE" or "de" give
// "de"). Only the languages the help is written in, and only their main
// regions, have a folder; every other name, other regions included ("de_AT",
// "fr_CA"), gives "en".
wxString HelpFolderLanguage(const wxString& canonicalName);
