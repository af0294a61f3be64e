// Removing files that another program may still be using.
#pragma once

#include <wx/string.h>

// Removes `path` when it is a regular file of the user's own that no process
// holds open. A link is never followed, and a file whose use cannot be told
// stays. True when the file was removed.
bool RemoveFileIfUnused(const wxString& path);
