// The launcher's IPC: conversations with a service by name on a topic, carrying
// pokes, with every wait bounded and every length checked before anything is
// allocated. The transport is the system's: the toolkit's IPC protocol over
// Unix sockets in the user's private directory, or DDE.
#pragma once

#include <wx/ipcbase.h>
#include <wx/string.h>

#include <memory>

// How long a connection attempt may take in all, waiting for a server included.
constexpr int kIpcConnectTimeoutMs = 3000;

// How long a server waits for each message of a peer before dropping it.
constexpr int kIpcPeerTimeoutMs = 3000;

// The largest poke data accepted, terminating NUL included.
constexpr size_t kIpcMaxPokeSize = 64 * 1024;

// The longest topic or item name accepted.
constexpr size_t kIpcMaxNameSize = 1024;

// False when `service` can never be reached: a name the transport refuses
// (empty, and on Linux ".", "..", one holding a "/" or a NUL, or too long for a
// socket address) or no safe place to serve it. A connection to it fails at
// once, so there is nothing to wait for.
bool IsServiceNameUsable(const wxString& service);

class IpcChannel;
class IpcListener;

// One conversation. On the client's side it sends pokes until its deadline; on
// the server's side it receives them through OnPoke. Only its holder deletes it.
class IpcConnection : public wxConnectionBase
{
public:
    IpcConnection();
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
    friend class IpcListener;
    // The system's end of a conversation the client opened.
    std::unique_ptr<IpcChannel> m_channel;
};

// A server that registers a service by name and serves it from the GUI event
// loop: a peer that stalls, sends too much or breaks the protocol is dropped,
// never waited for. At its end it gives up its name only while the name is
// still its own: a newer server of the same name keeps it.
class IpcServer : public wxServerBase
{
public:
    IpcServer();
    ~IpcServer() override;

    // False, with nothing registered, when the name is refused or cannot be
    // registered. What a server that died left of the name is replaced.
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
