// The second copy's side of the raise service: ask the running copy to come to
// the front, and to open a file, then end.
#pragma once

#include <wx/string.h>

// Pokes "Raise", or "Raise* " and `path`, to `service`. A running copy that
// holds the lock but has no service yet is tried again for up to 2 s. The whole
// hand-over is bounded to a few seconds: a copy that does not answer in time
// ends this process silently, whatever the toolkit is waiting for.
void HandOverToRunningCopy(const wxString& service, const wxString& path);
