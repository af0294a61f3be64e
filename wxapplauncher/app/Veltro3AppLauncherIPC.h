// The raise service of the running copy: a later copy of the launcher asks it
// to come to the front and, when given a file, to open it in Inspect.
#pragma once

#include "platform/Ipc.h"

// Accepts conversations on the topic "IPC START" only.
class Veltro3AppLauncherIPCServer : public IpcServer
{
public:
    wxConnectionBase* OnAcceptConnection(const wxString& topic) override;
};

class Veltro3AppLauncherIPCConnection : public IpcConnection
{
public:
    // "Raise" brings the main frame up (restoring it when minimised) once it is
    // shown; "Raise* <path>" also opens the path in Inspect. False, and nothing
    // changes, for another item, text that is not acceptable poke text, text not
    // starting with "Raise", a "*" without the blank after it, or no main frame
    // (but one start-up has still to make: its path waits for it).
    bool OnPoke(const wxString& topic, const wxString& item, const void* data, size_t size,
                wxIPCFormat format) override;
};
