#include "platform/Ipc.h"

#include "platform/IpcWire.h"
#include "platform/PrivateRuntimeDir.h"

#include <cerrno>
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

IpcConnection::~IpcConnection()
{
    Disconnect();
}

bool IpcConnection::Disconnect()
{
    if (m_fd >= 0) {
        const char bye = kIpcDisconnect;
        send(m_fd, &bye, 1, MSG_NOSIGNAL | MSG_DONTWAIT);
        close(m_fd);
        m_fd = -1;
    }
    SetConnected(false);
    return true;
}

bool IpcConnection::DoPoke(const wxString& item, const void* data, size_t size, wxIPCFormat format)
{
    if (m_fd < 0 || size > std::numeric_limits<std::uint32_t>::max())
        return false;
    std::string message(1, static_cast<char>(kIpcPoke));
    message += IpcName(item);
    message += static_cast<char>(format);
    AppendIpcBlock(message, data, static_cast<std::uint32_t>(size));
    return SendAll(m_fd, message, m_deadline);
}

wxConnectionBase* IpcClient::Connect(const wxString& service, const wxString& topic, int timeoutMs)
{
    const wxString path = GetServiceSocketPath(service);
    if (path.empty())
        return nullptr;
    auto connection = std::make_unique<IpcConnection>();
    connection->m_deadline = Clock::now() + std::chrono::milliseconds(timeoutMs);
    connection->m_fd = OpenSocket(path, connection->m_deadline);
    const int fd = connection->m_fd;
    unsigned char answer = kIpcFail;
    if (fd < 0 ||
        !SendAll(fd, std::string(1, static_cast<char>(kIpcConnect)) + IpcName(topic),
                 connection->m_deadline) ||
        !WaitUntil(fd, POLLIN, connection->m_deadline) || recv(fd, &answer, 1, 0) != 1 ||
        answer != kIpcConnect) {
        // No conversation was opened: nothing to end.
        if (fd >= 0)
            close(fd);
        connection->m_fd = -1;
        return nullptr;
    }
    return connection.release();
}

bool ReadPokeText(const void* data, size_t size, wxIPCFormat format, wxString& text)
{
    text.clear();
    if (!data || size > kIpcMaxPokeSize || (format != wxIPC_TEXT && format != wxIPC_UTF8TEXT))
        return false;
    const char* bytes = static_cast<const char*>(data);
    const void* end = std::memchr(bytes, '\0', size);
    const size_t length = end ? static_cast<const char*>(end) - bytes : size;
    text = wxString::FromUTF8(bytes, length);
    return length == 0 || !text.empty();
}
