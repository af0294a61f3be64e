// The per-user private directory that holds the instance lock and the IPC sockets.
#pragma once

#include <wx/string.h>

// $XDG_RUNTIME_DIR/veltrona/; without XDG_RUNTIME_DIR, <cache>/veltrona-<host>/
// ($XDG_CACHE_HOME, else ~/.cache), or /tmp/veltrona-<uid>/ when that path is too
// long for socket addresses. Created with mode 0700. Empty when the directory
// cannot be made or is not safe to use: a link, owned by someone else, or open
// to the group or others.
wxString GetPrivateRuntimeDir();
