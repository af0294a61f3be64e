#include "platform/InstanceLock.h"

#include "platform/unix/PrivateRuntimeDir.h"

#include <cerrno>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

// An flock on a file in the private runtime directory; the kernel drops it with
// its holder. The file is never deleted, so two copies always contend for the
// same file.
struct InstanceLock::Held
{
    explicit Held(int fd) : fd(fd) {}
    ~Held() { close(fd); }
    Held(const Held&) = delete;
    Held& operator=(const Held&) = delete;

    const int fd;
};

InstanceLock::InstanceLock() = default;

InstanceLock::~InstanceLock() = default;

bool InstanceLock::Create(const wxString& name, const wxString& dir)
{
    m_held.reset();
    m_anotherRunning = false;

    wxString folder = dir.empty() ? GetPrivateRuntimeDir() : dir;
    if (folder.empty() || name.empty() || name.Contains("/"))
        return false;
    if (!folder.EndsWith("/"))
        folder += "/";

    // Close-on-exec: started modules must not keep the lock after the launcher ends.
    const int fd = open((folder + name).fn_str(), O_RDWR | O_CREAT | O_NOFOLLOW | O_CLOEXEC, 0600);
    if (fd < 0)
        return false;
    struct stat info;
    if (fstat(fd, &info) != 0 || !S_ISREG(info.st_mode) || info.st_uid != getuid()) {
        close(fd);
        return false;
    }

    int result;
    do
        result = flock(fd, LOCK_EX | LOCK_NB);
    while (result != 0 && errno == EINTR);
    if (result != 0) {
        m_anotherRunning = errno == EWOULDBLOCK;
        close(fd);
        return m_anotherRunning;
    }
    m_held = std::make_unique<Held>(fd);
    return true;
}
