// Where the help viewer stand-in finds a program's page in the installation.
#pragma once

#include <wx/string.h>

// The page file for `applicationId` ("LaunchPad", "LinkStudio", ...) below
// `installDir`/Documentation/<language>/Help/, with the user's two-letter
// language when that folder exists and "en" otherwise. A page that is not
// there gives the folder's "AlternateHelp.html".
wxString FindHelpPage(const wxString& installDir, const wxString& applicationId,
                      const wxString& page);
