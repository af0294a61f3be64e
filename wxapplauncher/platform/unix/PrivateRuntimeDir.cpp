#include "platform/unix/PrivateRuntimeDir.h"

#include <wx/filename.h>
#include <wx/utils.h>

#include <cerrno>
#include <climits>
#include <cstdlib>
#include <string>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>

namespace {

// Room left for the names in the directory: the raise service's socket
// "Zelgrave.Veltrona.<user>.ipc" for a user name of 32 characters.
const size_t kLongestEntryName = 54;

// The variable's value when it is an absolute path; the XDG rules say a
// relative one is to be ignored (it would follow the working directory).
std::string AbsoluteEnv(const char* name)
{
    const char* value = std::getenv(name);
    return value && *value == '/' ? std::string(value) : std::string();
}

// $XDG_CACHE_HOME, else ~/.cache, holds one folder per machine: a home shared
// between machines must not lead one machine's copy to another's lock, whose
// sockets it cannot reach.
std::string CacheRuntimeDir()
{
    std::string cache = AbsoluteEnv("XDG_CACHE_HOME");
    if (cache.empty()) {
        const std::string home(wxGetHomeDir().fn_str());
        if (home.empty() || home[0] != '/')
            return std::string();
        cache = home + "/.cache";
    }
    char host[HOST_NAME_MAX + 1] = {};
    gethostname(host, HOST_NAME_MAX);
    return cache + "/veltrona-" + host;
}

} // namespace

wxString GetPrivateRuntimeDir()
{
    std::string dir = AbsoluteEnv("XDG_RUNTIME_DIR");
    if (!dir.empty()) {
        dir += "/veltrona";
    } else {
        // A fixed name in /tmp can be taken first by another user. The cache
        // folder is the user's own; /tmp serves only when the cache's path
        // leaves too little room for a socket's name. The choice depends on the
        // environment alone, so that every copy lands on the same directory.
        dir = CacheRuntimeDir();
        if (dir.empty() || dir.size() + 1 + kLongestEntryName >= sizeof(sockaddr_un::sun_path))
            dir = "/tmp/veltrona-" + std::to_string(getuid());
        else
            wxFileName::Mkdir(wxString::FromUTF8(dir), 0700, wxPATH_MKDIR_FULL);
    }
    if (mkdir(dir.c_str(), 0700) != 0 && errno != EEXIST)
        return wxString();

    struct stat info;
    if (lstat(dir.c_str(), &info) != 0 || !S_ISDIR(info.st_mode) || info.st_uid != getuid() ||
        (info.st_mode & 077) != 0)
        return wxString();
    return wxString::FromUTF8(dir + "/");
}
