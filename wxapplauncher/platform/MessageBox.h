// The launcher's message boxes: the toolkit's native box, with its caption always
// on the title bar and the icon of its style beside the text.
#pragma once

#include <wx/string.h>

// As wxMessageBox without a parent window. wxGTK leaves the title empty when the
// caption is its own default "Message" (as the English and French ones are), and
// GTK 3's message dialog draws no icon for the message type it is given.
int ShowMessageBox(const wxString& message, const wxString& caption, long style);
