// The launcher's own help service, through which the help viewer may talk back.
#pragma once

#include "platform/Ipc.h"

// Accepts conversations on the topic "IPC START" only.
class CContextualIPCServer : public IpcServer
{
public:
    wxConnectionBase* OnAcceptConnection(const wxString& topic) override;
};

// Answers every poke as not processed: the viewer's only message, one that
// contains "Exit", asks nothing of the launcher.
class CContextualIPCConnection : public IpcConnection
{
public:
    bool OnPoke(const wxString& topic, const wxString& item, const void* data, size_t size,
                wxIPCFormat format) override;
};
