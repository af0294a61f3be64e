// The launcher's IPC: the toolkit's socket IPC protocol over Unix sockets that
// live in the user's private directory, one socket per service name, with every
// wait bounded and every length checked before anything is allocated.
#pragma once

#include <wx/ipcbase.h>
#include <wx/string.h>

#include <chrono>
#include <memory>

// How long a connection attempt may take in all, waiting for a server included.
constexpr int kIpcConnectTimeoutMs = 3000;

// How long a server waits for each message of a peer before dropping it.
constexpr int kIpcPeerTimeoutMs = 3000;

// The largest poke data accepted, terminating NUL included.
constexpr size_t kIpcMaxPokeSize = 64 * 1024;

// The longest topic or item name accepted.
constexpr size_t kIpcMaxNameSize = 1024;

// The socket path of `service` in the private directory. Empty when the name is
// empty, ".", "..", or holds a "/" or a NUL, when the private directory is not
// safe to use, or when the path does not fit a Unix socket address.
wxString GetServiceSocketPath(const wxString& service);

// One conversation. On the client's side it sends pokes until its deadline; on
// the server's side it receives them through OnPoke. Only its holder deletes it.
class IpcConnection : public wxConnectionBase
{
public:
    IpcConnection() = default;
    ~IpcConnection() override;

    bool Disconnect() override;
    bool OnDisconnect() override { return true; }
    const void* Request(const wxString&, size_t*, wxIPCFormat) override { return nullptr; }
    bool StartAdvise(const wxString&) override { return false; }
    bool StopAdvise(const wxString&) override { return false; }

protected:
    bool DoPoke(const wxString& item, const void* data, size_t size, wxIPCFormat format) override;
    bool DoExecute(const void*, size_t, wxIPCFormat) override { return false; }
    bool DoAdvise(const wxString&, const void*, size_t, wxIPCFormat) override { return false; }

private:
    friend class IpcClient;
    int m_fd = -1;
    std::chrono::steady_clock::time_point m_deadline;
};

class IpcListener;

// A server that registers a service by name and serves it from the GUI event
// loop: a peer that stalls, sends too much or breaks the protocol is dropped,
// never waited for. At its end it removes its socket only while the file is
// still the one it made: a newer server at the same path keeps its socket.
class IpcServer : public wxServerBase
{
public:
    IpcServer();
    ~IpcServer() override;

    // False, with nothing registered, when the socket path is refused or the
    // socket cannot be bound. A stale socket at the path is replaced.
    bool Create(const wxString& service) override;

    // The connection for a conversation on `topic`; null refuses it.
    wxConnectionBase* OnAcceptConnection(const wxString& topic) override;

private:
    std::unique_ptr<IpcListener> m_listener;
};

class IpcClient
{
public:
    // Connects to `service` on `topic`. The attempt, and every poke on the
    // connection, ends by one deadline `timeoutMs` from now, however the server
    // behaves. Null when the service is refused, absent, refuses the topic or
    // does not answer in time.
    wxConnectionBase* Connect(const wxString& service, const wxString& topic,
                              int timeoutMs = kIpcConnectTimeoutMs);
};

// The text of a poke when it is acceptable: byte text (wxIPC_TEXT or
// wxIPC_UTF8TEXT) of at most kIpcMaxPokeSize bytes, taken up to the first NUL,
// valid UTF-8. False for anything else; `text` is then empty.
bool ReadPokeText(const void* data, size_t size, wxIPCFormat format, wxString& text);
