// The launcher's IPC: the toolkit's socket transport over Unix sockets that
// live in the user's private directory, one socket per service name.
#pragma once

#include <wx/sckipc.h>
#include <wx/string.h>

#include <sys/types.h>

// How long a connection attempt may take in all, waiting for a server included.
constexpr int kIpcConnectTimeoutMs = 3000;

// The largest poke data accepted, terminating NUL included.
constexpr size_t kIpcMaxPokeSize = 64 * 1024;

// The socket path of `service` in the private directory. Empty when the name is
// empty, ".", "..", or holds a "/" or a NUL, when the private directory is not
// safe to use, or when the path does not fit a Unix socket address (the toolkit
// would silently bind an abstract socket instead).
wxString GetServiceSocketPath(const wxString& service);

// A server that registers a service by name and, at its end, removes its socket
// only while the file is still the one it made: a newer server at the same path
// keeps its socket.
class IpcServer : public wxTCPServer
{
public:
    ~IpcServer() override;

    // False, with nothing registered, when the socket path is refused or the
    // socket cannot be bound. A stale socket at the path is replaced.
    bool Create(const wxString& service) override;

private:
    dev_t m_device = 0;
    ino_t m_inode = 0;
};

// A client whose connections belong to the caller, who deletes them once: a
// connection the peer drops is only marked as disconnected.
class IpcClient : public wxTCPClient
{
public:
    // Connects to `service` on `topic`. The whole attempt takes at most
    // `timeoutMs`, however the server behaves (the toolkit alone would wait ten
    // minutes for a server that accepts but never answers). Null when the
    // service is refused, absent, refuses the topic or does not answer in time.
    wxConnectionBase* Connect(const wxString& service, const wxString& topic,
                              int timeoutMs = kIpcConnectTimeoutMs);

    wxConnectionBase* OnMakeConnection() override;
};

// The text of a poke when it is acceptable: byte text (wxIPC_TEXT or
// wxIPC_UTF8TEXT) of at most kIpcMaxPokeSize bytes, taken up to the first NUL,
// valid UTF-8. False for anything else; `text` is then empty.
bool ReadPokeText(const void* data, size_t size, wxIPCFormat format, wxString& text);
