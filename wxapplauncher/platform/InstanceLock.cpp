#include "platform/InstanceLock.h"

#include <wx/filefn.h>
#include <wx/utils.h>

#include <fcntl.h>
#include <unistd.h>

void RemoveStaleInstanceLock(const wxString& dir, const wxString& name)
{
    wxString folder = dir.empty() ? wxGetHomeDir() : dir;
    if (!folder.EndsWith("/"))
        folder += "/";
    const wxString path = folder + name;

    const int fd = open(path.fn_str(), O_RDONLY | O_NOFOLLOW | O_CLOEXEC);
    if (fd < 0)
        return;

    // The holder keeps a write lock on the file for as long as it runs; the
    // kernel drops it when the holder dies, however it ends.
    struct flock probe = {};
    probe.l_type = F_WRLCK;
    probe.l_whence = SEEK_SET;
    const bool free = fcntl(fd, F_GETLK, &probe) == 0 && probe.l_type == F_UNLCK;
    close(fd);
    if (free)
        wxRemoveFile(path);
}
