#include "help/CContextualIPC.h"

wxConnectionBase* CContextualIPCServer::OnAcceptConnection(const wxString& topic)
{
    if (topic != "IPC START")
        return nullptr;
    return new CContextualIPCConnection;
}

bool CContextualIPCConnection::OnPoke(const wxString&, const wxString&, const void*, size_t,
                                      wxIPCFormat)
{
    return false;
}
