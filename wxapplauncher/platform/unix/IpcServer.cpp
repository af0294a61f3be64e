#include "platform/Ipc.h"

#include "platform/unix/IpcPeer.h"

#include <wx/evtloop.h>
#include <wx/evtloopsrc.h>
#include <wx/timer.h>

#include <cerrno>
#include <chrono>
#include <cstring>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>

namespace {

const int kDeadlineCheckMs = 500;

} // namespace

class IpcSocketPeer;

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

    void Serve(IpcSocketPeer& peer);

private:
    void DropLatePeers();

    IpcServer& m_server;
    int m_fd;
    std::string m_path;
    struct stat m_bound = {};
    std::unique_ptr<wxEventLoopSource> m_source;
    IpcPeerTable m_peers;
    wxTimer m_deadlineCheck;
};

// One accepted socket and its peer's side of the protocol.
class IpcSocketPeer : public IpcPeer, public wxEventLoopSourceHandler
{
public:
    IpcSocketPeer(IpcListener& listener, IpcServer& server, int fd)
        : m_listener(listener), m_server(server), m_fd(fd),
          m_source(wxEventLoopBase::AddSourceForFD(fd, this, wxEVENT_SOURCE_INPUT))
    {
    }
    ~IpcSocketPeer() override
    {
        m_source.reset();
        close(m_fd);
    }
    void OnReadWaiting() override { m_listener.Serve(*this); }
    void OnWriteWaiting() override {}
    void OnExceptionWaiting() override {}

    IpcListener& m_listener;
    IpcServer& m_server;
    const int m_fd;
    std::unique_ptr<wxEventLoopSource> m_source;

protected:
    wxConnectionBase* Accept(const wxString& topic) override
    {
        return m_server.OnAcceptConnection(topic);
    }
    bool Answer(IpcCode code) override
    {
        const char byte = static_cast<char>(code);
        return send(m_fd, &byte, 1, MSG_NOSIGNAL | MSG_DONTWAIT) == 1;
    }
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
    m_peers.Clear();
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
    auto peer = std::make_unique<IpcSocketPeer>(*this, m_server, fd);
    if (!peer->m_source || !m_peers.Add(std::move(peer)))
        return;
    if (!m_deadlineCheck.IsRunning())
        m_deadlineCheck.Start(kDeadlineCheckMs);
}

void IpcListener::Serve(IpcSocketPeer& peer)
{
    // One read per call, so that a peer that never stops sending cannot keep
    // the event loop from everything else.
    char chunk[4096];
    const ssize_t got = recv(peer.m_fd, chunk, sizeof chunk, 0);
    if (got < 0 && (errno == EAGAIN || errno == EINTR))
        return;
    switch (peer.Receive(chunk, got > 0 ? static_cast<size_t>(got) : 0)) {
    case IpcPeer::Step::Keep:
        break;
    case IpcPeer::Step::Pause:
        peer.m_source.reset();
        break;
    case IpcPeer::Step::Drop:
        m_peers.Drop(peer);
        break;
    }
}

void IpcListener::DropLatePeers()
{
    m_peers.DropLate(std::chrono::steady_clock::now());
    if (m_peers.Size() == 0)
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
