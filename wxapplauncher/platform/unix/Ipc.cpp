#include "platform/Ipc.h"

#include "platform/unix/IpcWire.h"
#include "platform/unix/PrivateRuntimeDir.h"

#include <cerrno>
#include <chrono>
#include <cstring>
#include <limits>
#include <poll.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <thread>
#include <unistd.h>

namespace {

using Clock = std::chrono::steady_clock;

// Waits for `events` on `fd` until the deadline; false when it passed first.
bool WaitUntil(int fd, short events, Clock::time_point deadline)
{
    for (;;) {
        const auto left =
            std::chrono::duration_cast<std::chrono::milliseconds>(deadline - Clock::now()).count();
        pollfd waiting = {fd, events, 0};
        const int ready = poll(&waiting, 1, left > 0 ? static_cast<int>(left) : 0);
        if (ready >= 0 || errno != EINTR)
            return ready == 1;
    }
}

bool SendAll(int fd, const std::string& bytes, Clock::time_point deadline)
{
    for (size_t sent = 0; sent < bytes.size();) {
        const ssize_t n =
            send(fd, bytes.data() + sent, bytes.size() - sent, MSG_NOSIGNAL | MSG_DONTWAIT);
        if (n > 0)
            sent += static_cast<size_t>(n);
        else if (n < 0 && errno != EINTR && (errno != EAGAIN || !WaitUntil(fd, POLLOUT, deadline)))
            return false;
    }
    return true;
}

std::string IpcName(const wxString& name)
{
    const std::string bytes(name.utf8_str());
    std::string block;
    AppendIpcBlock(block, bytes.data(), static_cast<std::uint32_t>(bytes.size()));
    return block;
}

// Opens a socket to the server at `path`; -1 when there is none or its queue
// stays full until the deadline.
int OpenSocket(const wxString& path, Clock::time_point deadline)
{
    sockaddr_un address = {};
    address.sun_family = AF_UNIX;
    const std::string bytes(path.utf8_str());
    std::memcpy(address.sun_path, bytes.c_str(), bytes.size() + 1);
    const int fd = socket(AF_UNIX, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0);
    // A full queue (a server that stopped accepting) answers EAGAIN at once.
    while (fd >= 0 &&
           connect(fd, reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0) {
        if ((errno != EAGAIN && errno != EINTR) || Clock::now() >= deadline) {
            close(fd);
            return -1;
        }
        std::this_thread::sleep_for(std::chrono::milliseconds(20));
    }
    return fd;
}

} // namespace

// A client's socket and the deadline of its whole conversation.
class IpcChannel
{
public:
    IpcChannel(int fd, Clock::time_point deadline) : m_fd(fd), m_deadline(deadline) {}
    ~IpcChannel() { close(m_fd); }
    IpcChannel(const IpcChannel&) = delete;
    IpcChannel& operator=(const IpcChannel&) = delete;

    bool Send(const std::string& bytes) const { return SendAll(m_fd, bytes, m_deadline); }

    // The server's answer to the topic: true when it opened the conversation.
    bool Opened() const
    {
        unsigned char answer = kIpcFail;
        return WaitUntil(m_fd, POLLIN, m_deadline) && recv(m_fd, &answer, 1, 0) == 1 &&
               answer == kIpcConnect;
    }

    void SayGoodbye() const
    {
        const char bye = kIpcDisconnect;
        send(m_fd, &bye, 1, MSG_NOSIGNAL | MSG_DONTWAIT);
    }

private:
    const int m_fd;
    const Clock::time_point m_deadline;
};

wxString GetServiceSocketPath(const wxString& service)
{
    if (service.empty() || service == "." || service == ".." || service.Find('/') != wxNOT_FOUND ||
        service.Find(wxUniChar(0)) != wxNOT_FOUND)
        return wxString();
    const wxString dir = GetPrivateRuntimeDir();
    if (dir.empty())
        return wxString();
    const wxString path = dir + service;
    if (std::strlen(path.utf8_str()) >= sizeof(sockaddr_un::sun_path))
        return wxString();
    return path;
}

bool IsServiceNameUsable(const wxString& service)
{
    return !GetServiceSocketPath(service).empty();
}

IpcConnection::IpcConnection() = default;

IpcConnection::~IpcConnection()
{
    Disconnect();
}

bool IpcConnection::Disconnect()
{
    if (m_channel) {
        m_channel->SayGoodbye();
        m_channel.reset();
    }
    SetConnected(false);
    return true;
}

bool IpcConnection::DoPoke(const wxString& item, const void* data, size_t size, wxIPCFormat format)
{
    if (!m_channel || size > std::numeric_limits<std::uint32_t>::max())
        return false;
    std::string message(1, static_cast<char>(kIpcPoke));
    message += IpcName(item);
    message += static_cast<char>(format);
    AppendIpcBlock(message, data, static_cast<std::uint32_t>(size));
    return m_channel->Send(message);
}

wxConnectionBase* IpcClient::Connect(const wxString& service, const wxString& topic, int timeoutMs)
{
    const wxString path = GetServiceSocketPath(service);
    if (path.empty())
        return nullptr;
    const auto deadline = Clock::now() + std::chrono::milliseconds(timeoutMs);
    const int fd = OpenSocket(path, deadline);
    if (fd < 0)
        return nullptr;
    // Until the server opened the conversation there is nothing to end: the
    // channel closes without a goodbye.
    auto channel = std::make_unique<IpcChannel>(fd, deadline);
    if (!channel->Send(std::string(1, static_cast<char>(kIpcConnect)) + IpcName(topic)) ||
        !channel->Opened())
        return nullptr;
    auto connection = std::make_unique<IpcConnection>();
    connection->m_channel = std::move(channel);
    return connection.release();
}
