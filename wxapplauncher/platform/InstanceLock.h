// Keeps a dead copy's instance lock from stopping new copies.
#pragma once

#include <wx/string.h>

// Removes the lock file `name` in `dir` (the home directory when `dir` is empty)
// when no running process holds its lock. The toolkit's checker trusts the
// process id written in the file, which a killed copy leaves behind and which
// the system may hand to an unrelated process later.
void RemoveStaleInstanceLock(const wxString& dir, const wxString& name);
