#include "platform/PrivateRuntimeDir.h"

#include <cerrno>
#include <cstdlib>
#include <string>
#include <sys/stat.h>
#include <unistd.h>

wxString GetPrivateRuntimeDir()
{
    const char* runtime = std::getenv("XDG_RUNTIME_DIR");
    // A relative XDG_RUNTIME_DIR is invalid and would follow the working directory.
    std::string dir = runtime && *runtime == '/' ? std::string(runtime) + "/veltrona"
                                                 : "/tmp/veltrona-" + std::to_string(getuid());
    if (mkdir(dir.c_str(), 0700) != 0 && errno != EEXIST)
        return wxString();

    struct stat info;
    if (lstat(dir.c_str(), &info) != 0 || !S_ISDIR(info.st_mode) || info.st_uid != getuid() ||
        (info.st_mode & 077) != 0)
        return wxString();
    return wxString::FromUTF8(dir + "/");
}
