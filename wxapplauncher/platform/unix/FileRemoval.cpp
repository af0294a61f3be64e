#include "platform/FileRemoval.h"

#include <csignal>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

// The kernel grants a write lease only while no other open file refers to the
// file, whoever holds it; unlike /proc, this also sees processes of other users
// and those that may not be inspected, at one call per file. A lease broken
// meanwhile signals with SIGURG, ignored by default, not SIGIO, which would end
// the launcher. Where there are no leases the file counts as in use.
bool TakeLeaseIfUnused(int fd)
{
    return fcntl(fd, F_SETSIG, SIGURG) == 0 && fcntl(fd, F_SETLEASE, F_WRLCK) == 0;
}

} // namespace

bool RemoveFileIfUnused(const wxString& path)
{
    const int fd = open(path.fn_str(), O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC);
    if (fd < 0)
        return false;
    bool removed = false;
    struct stat info;
    if (fstat(fd, &info) == 0 && S_ISREG(info.st_mode) && info.st_uid == getuid() &&
        TakeLeaseIfUnused(fd)) {
        removed = unlink(path.fn_str()) == 0;
        fcntl(fd, F_SETLEASE, F_UNLCK);
    }
    close(fd);
    return removed;
}
