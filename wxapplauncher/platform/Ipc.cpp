#include "platform/Ipc.h"

#include "platform/PrivateRuntimeDir.h"

#include <cerrno>
#include <chrono>
#include <cstdint>
#include <cstring>
#include <poll.h>
#include <string>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <thread>
#include <unistd.h>

namespace {

// The toolkit's wire codes for opening and closing a conversation.
const unsigned char kIpcConnect = 10;
const unsigned char kIpcDisconnect = 11;

using Clock = std::chrono::steady_clock;

int MillisecondsLeft(Clock::time_point deadline)
{
    const auto left =
        std::chrono::duration_cast<std::chrono::milliseconds>(deadline - Clock::now()).count();
    return left > 0 ? static_cast<int>(left) : 0;
}

class FileDescriptor
{
public:
    explicit FileDescriptor(int fd) : m_fd(fd) {}
    ~FileDescriptor()
    {
        if (m_fd >= 0)
            close(m_fd);
    }
    FileDescriptor(const FileDescriptor&) = delete;
    FileDescriptor& operator=(const FileDescriptor&) = delete;
    int Get() const { return m_fd; }

private:
    int m_fd;
};

// Opens a conversation on `topic` as the toolkit's client does and waits, up to
// the deadline, for the server's answer. The toolkit's own client is used only
// once a server has shown that it answers; it would otherwise wait for minutes.
bool ServerAnswers(const std::string& path, const wxString& topic, Clock::time_point deadline)
{
    sockaddr_un address = {};
    address.sun_family = AF_UNIX;
    std::memcpy(address.sun_path, path.c_str(), path.size() + 1);

    FileDescriptor socketFd(socket(AF_UNIX, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0));
    if (socketFd.Get() < 0)
        return false;
    // A full backlog (a server that stopped accepting) answers EAGAIN at once.
    while (connect(socketFd.Get(), reinterpret_cast<const sockaddr*>(&address), sizeof address) !=
           0) {
        if (errno != EAGAIN || MillisecondsLeft(deadline) == 0)
            return false;
        std::this_thread::sleep_for(std::chrono::milliseconds(20));
    }

    const std::string name(topic.utf8_str());
    std::string request(1, static_cast<char>(kIpcConnect));
    const auto length = static_cast<std::uint32_t>(name.size());
    for (int shift = 0; shift < 32; shift += 8)
        request += static_cast<char>((length >> shift) & 0xff);
    request += name;
    if (send(socketFd.Get(), request.data(), request.size(), MSG_NOSIGNAL) !=
        static_cast<ssize_t>(request.size()))
        return false;

    pollfd waiting = {socketFd.Get(), POLLIN, 0};
    int ready;
    do
        ready = poll(&waiting, 1, MillisecondsLeft(deadline));
    while (ready < 0 && errno == EINTR);
    unsigned char answer = 0;
    if (ready != 1 || recv(socketFd.Get(), &answer, 1, 0) != 1 || answer != kIpcConnect)
        return false;
    send(socketFd.Get(), &kIpcDisconnect, 1, MSG_NOSIGNAL);
    return true;
}

// Ends with the caller's delete only; the toolkit's default deletes a
// connection whose peer went away, behind the back of whoever holds it.
class OwnedConnection : public wxTCPConnection
{
public:
    bool OnDisconnect() override { return true; }
};

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

IpcServer::~IpcServer()
{
    // The toolkit's destructor removes whatever file is at the path now.
    if (!m_filename.empty()) {
        struct stat info;
        if (lstat(m_filename.utf8_str(), &info) == 0 && info.st_dev == m_device &&
            info.st_ino == m_inode)
            unlink(m_filename.utf8_str());
        m_filename.clear();
    }
}

bool IpcServer::Create(const wxString& service)
{
    const wxString path = GetServiceSocketPath(service);
    struct stat info;
    if (path.empty() || !wxTCPServer::Create(path) || lstat(path.utf8_str(), &info) != 0 ||
        !S_ISSOCK(info.st_mode)) {
        // A failed bind leaves the path behind as if it were ours.
        m_filename.clear();
        return false;
    }
    m_device = info.st_dev;
    m_inode = info.st_ino;
    return true;
}

wxConnectionBase* IpcClient::Connect(const wxString& service, const wxString& topic, int timeoutMs)
{
    const wxString path = GetServiceSocketPath(service);
    if (path.empty())
        return nullptr;
    const auto deadline = Clock::now() + std::chrono::milliseconds(timeoutMs);
    if (!ServerAnswers(std::string(path.utf8_str()), topic, deadline))
        return nullptr;
    return MakeConnection("localhost", path, topic);
}

wxConnectionBase* IpcClient::OnMakeConnection()
{
    return new OwnedConnection;
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
