// The second copy's side of the raise service: ask the running copy to come to
// the front, and to open a file, then end.
#pragma once

#include <wx/string.h>

// Pokes "Raise", or "Raise* " and `path`, to `service`. A running copy that
// holds the lock but has no service yet is tried again for up to 2 s; the whole
// hand-over ends within a few seconds, however the running copy behaves. True
// once the poke is on its way to a copy that accepted the conversation.
bool HandOverToRunningCopy(const wxString& service, const wxString& path);
