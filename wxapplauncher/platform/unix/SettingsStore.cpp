#include "platform/SettingsStore.h"

#include <wx/file.h>
#include <wx/fileconf.h>
#include <wx/filename.h>
#include <wx/tokenzr.h>
#include <wx/utils.h>

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <sys/stat.h>
#include <unistd.h>

// A wxFileConfig over the user's file and the system-wide one. The user's file
// is written through a link, in the file it leads to, and only when it is
// missing or UTF-8 text that was read whole and may be replaced without losing
// a byte. A file that is read-only, not UTF-8 or unreadable is read as far as
// it can be and never written.
namespace {

const wxString kVendor = "Zelgrave";
// Far beyond any real settings file; a bigger one is not read.
const wxFileOffset kMaxFileSize = 1024 * 1024;

// The first absolute directory of a colon-separated list, or `fallback`.
wxString FirstAbsoluteDir(const wxString& list, const wxString& fallback)
{
    wxStringTokenizer dirs(list, ":", wxTOKEN_STRTOK);
    while (dirs.HasMoreTokens()) {
        const wxString dir = dirs.GetNextToken();
        if (dir.StartsWith("/"))
            return dir;
    }
    return fallback;
}

wxString SettingsFile(const wxString& dir, const wxString& appName)
{
    return wxFileName(dir + "/" + kVendor, appName + ".conf").GetFullPath();
}

enum class FileState
{
    Missing,
    Writable,
    ReadOnly,
    Lossy,
    Unusable
};

// Bytes that are not UTF-8 come through as private-use characters, so that one
// stray byte does not hide the rest of the file.
const wxMBConvUTF8 kLenientUtf8(wxMBConvUTF8::MAP_INVALID_UTF8_TO_PUA);

// The toolkit writes by renaming a new file over the old one, which would turn
// a link into a file of its own: the file a link leads to is the one to write.
// Empty for a link that leads nowhere.
wxString FollowLinks(const wxString& path)
{
    struct stat info;
    if (lstat(path.fn_str(), &info) != 0 || !S_ISLNK(info.st_mode))
        return path;
    char* target = realpath(path.fn_str(), nullptr);
    const wxString resolved = target ? wxString(target, *wxConvFileName) : wxString();
    free(target);
    return resolved;
}

// Unusable: not a regular file (a FIFO would block, a device never end), too
// big or unreadable. Lossy: not UTF-8 text that would be written back byte for
// byte. ReadOnly: without write permission (also for root, whom the system
// would let write it), or in a folder where no new file can replace it.
FileState CheckFile(const wxString& path)
{
    struct stat info;
    if (path.empty() || stat(path.fn_str(), &info) != 0)
        return !path.empty() && errno == ENOENT ? FileState::Missing : FileState::Unusable;
    if (!S_ISREG(info.st_mode) || info.st_size > kMaxFileSize)
        return FileState::Unusable;
    wxFile file(path);
    wxCharBuffer bytes(info.st_size);
    if (!file.IsOpened() || file.Read(bytes.data(), info.st_size) != info.st_size)
        return FileState::Unusable;
    size_t wideLength = 0, length = 0;
    const wxWCharBuffer text = kLenientUtf8.cMB2WC(bytes, bytes.length(), &wideLength);
    const wxCharBuffer back = kLenientUtf8.cWC2MB(text, wideLength, &length);
    if (info.st_size > 0 &&
        (wxConvUTF8.ToWChar(nullptr, 0, bytes, bytes.length()) == wxCONV_FAILED ||
         length != bytes.length() || std::memcmp(back, bytes, length) != 0))
        return FileState::Lossy;
    const wxString dir = wxFileName(path).GetPath();
    return (info.st_mode & 0222) && access(path.fn_str(), W_OK) == 0 &&
                   access(dir.fn_str(), W_OK) == 0
               ? FileState::Writable
               : FileState::ReadOnly;
}

// "<config home>/Zelgrave/<appName>.conf": $XDG_CONFIG_HOME when it is an
// absolute path, else ~/.config.
wxString UserFile(const wxString& appName)
{
    wxString home;
    wxGetEnv("XDG_CONFIG_HOME", &home);
    // The XDG rules say a relative path is to be ignored.
    if (!home.StartsWith("/"))
        home = wxGetHomeDir() + "/.config";
    return SettingsFile(home, appName);
}

// "<config dir>/Zelgrave/<appName>.conf": the first absolute directory of
// $XDG_CONFIG_DIRS, else /etc/xdg.
wxString SystemFile(const wxString& appName)
{
    wxString dirs;
    wxGetEnv("XDG_CONFIG_DIRS", &dirs);
    return SettingsFile(FirstAbsoluteDir(dirs, "/etc/xdg"), appName);
}

} // namespace

SettingsStore::SettingsStore(const wxString& appName)
{
    const wxString userFile = FollowLinks(UserFile(appName));
    const wxString systemFile = SystemFile(appName);
    const FileState user = CheckFile(userFile);
    const FileState system = CheckFile(systemFile);
    m_writable = user == FileState::Missing || user == FileState::Writable;

    long style = 0;
    if (user != FileState::Unusable)
        style |= wxCONFIG_USE_LOCAL_FILE;
    if (system != FileState::Missing && system != FileState::Unusable)
        style |= wxCONFIG_USE_GLOBAL_FILE;
    m_config = std::make_unique<wxFileConfig>(
        appName, kVendor, (style & wxCONFIG_USE_LOCAL_FILE) ? userFile : wxString(),
        (style & wxCONFIG_USE_GLOBAL_FILE) ? systemFile : wxString(), style, kLenientUtf8);
    // Values are taken as stored, "$HOME" included.
    m_config->SetExpandEnvVars(false);
}

SettingsStore::~SettingsStore() = default;

bool SettingsStore::Read(const wxString& key, wxString& value) const
{
    return m_config->Read(key, &value);
}

bool SettingsStore::Read(const wxString& key, long& value) const
{
    return m_config->Read(key, &value);
}

void SettingsStore::Write(const wxString& key, long value)
{
    if (!m_writable)
        return;
    // The toolkit does not create the user's folder; the settings are private.
    const wxString dir = wxFileName(UserFile(m_config->GetAppName())).GetPath();
    if (!wxFileName::DirExists(dir) && !wxFileName::Mkdir(dir, 0700, wxPATH_MKDIR_FULL))
        return;
    m_config->Write(key, value);
    m_config->Flush(false);
}
