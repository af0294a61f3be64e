// The user guide in the desktop's PDF reader, and the suite's web pages.
#pragma once

#include <wx/string.h>

// The suite maker's forum and how-to pages, and where a free PDF reader is.
extern const wxString kUserForumPage;
extern const wxString kHowToPage;
extern const wxString kReaderDownloadPage;

// Help > "User Guide": opens the guide in the user's language with the
// desktop's PDF reader; without a reader, first says where to get one and
// asks the desktop once more after OK.
void OpenUserGuide();
// Opens "<launcherDir>Help/Documentation/<folder>/Veltrona.pdf", the folder
// named by `language` ("de" for "de_DE", the whole name for Chinese, "en"
// when that folder is missing), or says that the guide is not there.
void OpenUserGuide(const wxString& launcherDir, const wxString& language);
// True when the desktop has a program that opens PDF files.
bool PdfReaderInstalled();

// Opens a web page in the desktop's browser; says so when it cannot.
void OpenURL(const wxString& address);
void OpenUserForum();
void OpenHowTo();
