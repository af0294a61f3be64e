#include "platform/Ipc.h"

#include "platform/LittleEndian.h"
#include "platform/unix/IpcWire.h"

#include <wx/evtloop.h>
#include <wx/evtloopsrc.h>
#include <wx/timer.h>

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <cstring>
#include <string>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>
#include <vector>

namespace {

using Clock = std::chrono::steady_clock;

// Peers beyond this push out the oldest one: a flood of idle peers never
// exhausts the launcher's descriptors.
const size_t kMaxPeers = 16;
const int kDeadlineCheckMs = 500;

enum class Read
{
    Ok,
    More, // the message is not complete yet
    Bad,  // a length beyond its limit, or a message the peer may not send now
};

// Reads the fields of one message from the front of a peer's input. Lengths are
// checked before their bytes are waited for or kept.
class FieldReader
{
public:
    explicit FieldReader(const std::string& input) : m_input(input) {}

    Read Byte(unsigned char& value)
    {
        if (m_input.size() - m_used < 1)
            return Read::More;
        value = static_cast<unsigned char>(m_input[m_used++]);
        return Read::Ok;
    }

    Read Block(std::string& value, size_t limit)
    {
        if (m_input.size() - m_used < 4)
            return Read::More;
        const std::uint32_t size =
            Le32(reinterpret_cast<const unsigned char*>(m_input.data()) + m_used);
        if (size > limit)
            return Read::Bad;
        if (m_input.size() - m_used - 4 < size)
            return Read::More;
        value.assign(m_input, m_used + 4, size);
        m_used += 4 + size;
        return Read::Ok;
    }

    size_t Used() const { return m_used; }

private:
    const std::string& m_input;
    size_t m_used = 0;
};

struct Message
{
    unsigned char code = 0, format = 0;
    std::string name, data;
};

// A peer opens one conversation, then pokes until it disconnects.
Read ReadMessage(FieldReader& in, bool connected, Message& message)
{
    Read read = in.Byte(message.code);
    if (read != Read::Ok)
        return read;
    if (message.code == kIpcConnect && !connected)
        return in.Block(message.name, kIpcMaxNameSize);
    if (message.code != kIpcPoke || !connected)
        return Read::Bad;
    if ((read = in.Block(message.name, kIpcMaxNameSize)) != Read::Ok ||
        (read = in.Byte(message.format)) != Read::Ok)
        return read;
    return in.Block(message.data, kIpcMaxPokeSize);
}

bool SendCode(int fd, IpcCode code)
{
    const char byte = static_cast<char>(code);
    return send(fd, &byte, 1, MSG_NOSIGNAL | MSG_DONTWAIT) == 1;
}

} // namespace

class IpcPeer;

// The listening socket and its peers, all watched on the GUI event loop.
class IpcListener : public wxEventLoopSourceHandler
{
public:
    IpcListener(IpcServer& server, int fd, const std::string& path);
    ~IpcListener() override;
    bool IsWatched() const { return m_source != nullptr; }

    void OnReadWaiting() override;
    void OnWriteWaiting() override {}
    void OnExceptionWaiting() override {}

    void Serve(IpcPeer& peer);

private:
    bool HandleMessages(IpcPeer& peer);
    void Drop(const IpcPeer& peer);
    void DropLatePeers();

    IpcServer& m_server;
    int m_fd;
    std::string m_path;
    struct stat m_bound = {};
    std::unique_ptr<wxEventLoopSource> m_source;
    std::vector<std::unique_ptr<IpcPeer>> m_peers;
    wxTimer m_deadlineCheck;
};

// One accepted socket: the bytes of its next message so far, the time by which
// that message must be complete, and its conversation once one is open.
class IpcPeer : public wxEventLoopSourceHandler
{
public:
    IpcPeer(IpcListener& listener, int fd)
        : m_listener(listener), m_fd(fd),
          m_source(wxEventLoopBase::AddSourceForFD(fd, this, wxEVENT_SOURCE_INPUT))
    {
    }
    ~IpcPeer() override
    {
        m_source.reset();
        close(m_fd);
    }
    void OnReadWaiting() override { m_listener.Serve(*this); }
    void OnWriteWaiting() override {}
    void OnExceptionWaiting() override {}

    IpcListener& m_listener;
    const int m_fd;
    std::unique_ptr<wxEventLoopSource> m_source;
    std::string m_input;
    Clock::time_point m_deadline = Clock::now() + std::chrono::milliseconds(kIpcPeerTimeoutMs);
    std::unique_ptr<wxConnectionBase> m_connection;
    wxString m_topic;
    // Inside its OnPoke, which may run nested event loops: not dropped meanwhile.
    bool m_busy = false;
    // Its stream ended while busy: dropped once the poke in progress returns.
    bool m_ended = false;
};

IpcListener::IpcListener(IpcServer& server, int fd, const std::string& path)
    : m_server(server), m_fd(fd), m_path(path)
{
    if (lstat(path.c_str(), &m_bound) == 0 && S_ISSOCK(m_bound.st_mode))
        m_source.reset(wxEventLoopBase::AddSourceForFD(fd, this, wxEVENT_SOURCE_INPUT));
    m_deadlineCheck.Bind(wxEVT_TIMER, [this](wxTimerEvent&) { DropLatePeers(); });
}

IpcListener::~IpcListener()
{
    m_peers.clear();
    m_source.reset();
    close(m_fd);
    struct stat now;
    if (lstat(m_path.c_str(), &now) == 0 && now.st_dev == m_bound.st_dev &&
        now.st_ino == m_bound.st_ino)
        unlink(m_path.c_str());
}

void IpcListener::OnReadWaiting()
{
    const int fd = accept4(m_fd, nullptr, nullptr, SOCK_NONBLOCK | SOCK_CLOEXEC);
    if (fd < 0)
        return;
    if (m_peers.size() >= kMaxPeers) {
        const auto oldest = std::find_if(m_peers.begin(), m_peers.end(),
                                         [](const auto& peer) { return !peer->m_busy; });
        if (oldest != m_peers.end())
            m_peers.erase(oldest);
    }
    auto peer = std::make_unique<IpcPeer>(*this, fd);
    if (!peer->m_source)
        return;
    m_peers.push_back(std::move(peer));
    if (!m_deadlineCheck.IsRunning())
        m_deadlineCheck.Start(kDeadlineCheckMs);
}

void IpcListener::Serve(IpcPeer& peer)
{
    // One read per call, so that a peer that never stops sending cannot keep
    // the event loop from everything else.
    char chunk[4096];
    const ssize_t got = recv(peer.m_fd, chunk, sizeof chunk, 0);
    if (got < 0 && (errno == EAGAIN || errno == EINTR))
        return;
    if (got > 0)
        peer.m_input.append(chunk, static_cast<size_t>(got));
    if (got <= 0)
        peer.m_ended = true;
    // A nested event loop inside the peer's own OnPoke: the handling further up
    // the stack goes on with what arrived, and drops the peer when it is done.
    if (peer.m_busy) {
        if (peer.m_ended)
            peer.m_source.reset();
        return;
    }
    // The end of the stream ends the conversation once what came before is handled.
    if (!HandleMessages(peer) || peer.m_ended)
        Drop(peer);
}

// Handles every complete message at the front of the input; false when the peer
// is to be dropped.
bool IpcListener::HandleMessages(IpcPeer& peer)
{
    for (;;) {
        FieldReader in(peer.m_input);
        Message message;
        const Read read = ReadMessage(in, peer.m_connection != nullptr, message);
        if (read == Read::More)
            return true;
        if (read == Read::Bad) {
            // The toolkit's server answers what it cannot handle with a failure.
            if (message.code != kIpcDisconnect)
                SendCode(peer.m_fd, kIpcFail);
            return false;
        }
        peer.m_input.erase(0, in.Used());
        peer.m_deadline = Clock::now() + std::chrono::milliseconds(kIpcPeerTimeoutMs);
        if (message.code == kIpcConnect) {
            peer.m_topic = wxString::FromUTF8(message.name);
            peer.m_connection.reset(m_server.OnAcceptConnection(peer.m_topic));
            if (!SendCode(peer.m_fd, peer.m_connection ? kIpcConnect : kIpcFail) ||
                !peer.m_connection)
                return false;
        } else {
            peer.m_busy = true;
            peer.m_connection->OnPoke(peer.m_topic, wxString::FromUTF8(message.name),
                                      message.data.data(), message.data.size(),
                                      static_cast<wxIPCFormat>(message.format));
            peer.m_busy = false;
        }
    }
}

void IpcListener::Drop(const IpcPeer& peer)
{
    const auto found = std::find_if(m_peers.begin(), m_peers.end(),
                                    [&peer](const auto& held) { return held.get() == &peer; });
    if (found != m_peers.end())
        m_peers.erase(found);
}

void IpcListener::DropLatePeers()
{
    const auto now = Clock::now();
    m_peers.erase(std::remove_if(
                      m_peers.begin(), m_peers.end(),
                      [now](const auto& peer) { return !peer->m_busy && peer->m_deadline <= now; }),
                  m_peers.end());
    if (m_peers.empty())
        m_deadlineCheck.Stop();
}

IpcServer::IpcServer() = default;

IpcServer::~IpcServer() = default;

bool IpcServer::Create(const wxString& service)
{
    m_listener.reset();
    const wxString path = GetServiceSocketPath(service);
    if (path.empty())
        return false;
    const std::string bytes(path.utf8_str());
    sockaddr_un address = {};
    address.sun_family = AF_UNIX;
    std::memcpy(address.sun_path, bytes.c_str(), bytes.size() + 1);

    // A socket left at the path by a server that is gone is replaced.
    struct stat existing;
    if (lstat(bytes.c_str(), &existing) == 0 && S_ISSOCK(existing.st_mode))
        unlink(bytes.c_str());
    const int fd = socket(AF_UNIX, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0);
    if (fd < 0)
        return false;
    if (bind(fd, reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0) {
        close(fd);
        return false;
    }
    auto listener = std::make_unique<IpcListener>(*this, fd, bytes);
    if (listen(fd, SOMAXCONN) != 0 || !listener->IsWatched())
        return false;
    m_listener = std::move(listener);
    return true;
}

wxConnectionBase* IpcServer::OnAcceptConnection(const wxString&)
{
    return nullptr;
}
