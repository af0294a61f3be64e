#include "settings/CProfileConfig.h"

#include <wx/ffile.h>
#include <wx/fileconf.h>
#include <wx/filename.h>
#include <wx/tokenzr.h>
#include <wx/utils.h>

#include <cerrno>
#include <sys/stat.h>

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
    Readable,
    Unusable
};

// Unusable: not a regular file (a FIFO would block, a device never end), too
// big, unreadable, or not UTF-8 text. The toolkit would read such a file as
// empty and then overwrite it with the one value written.
FileState CheckFile(const wxString& path)
{
    struct stat info;
    if (stat(path.fn_str(), &info) != 0)
        return errno == ENOENT ? FileState::Missing : FileState::Unusable;
    if (!S_ISREG(info.st_mode) || info.st_size > kMaxFileSize)
        return FileState::Unusable;
    wxFFile file(path, "rb");
    wxString text;
    if (!file.IsOpened() || !file.ReadAll(&text, wxConvUTF8))
        return FileState::Unusable;
    return text.empty() && info.st_size > 0 ? FileState::Unusable : FileState::Readable;
}

} // namespace

CProfileConfig::CProfileConfig(const wxString& appName) : m_config(nullptr), m_writable(false)
{
    const wxString userFile = UserFile(appName);
    const wxString systemFile = SystemFile(appName);
    const FileState user = CheckFile(userFile);
    m_writable = user != FileState::Unusable;

    long style = 0;
    if (m_writable)
        style |= wxCONFIG_USE_LOCAL_FILE;
    if (CheckFile(systemFile) == FileState::Readable)
        style |= wxCONFIG_USE_GLOBAL_FILE;
    m_config = new wxFileConfig(appName, kVendor, m_writable ? userFile : wxString(),
                                (style & wxCONFIG_USE_GLOBAL_FILE) ? systemFile : wxString(), style,
                                wxConvUTF8);
    // Values are taken as stored, "$HOME" included.
    m_config->SetExpandEnvVars(false);
}

CProfileConfig::~CProfileConfig()
{
    delete m_config;
}

wxString CProfileConfig::ReadString(const wxString& key, const wxString& defaultValue) const
{
    return m_config ? m_config->Read(key, defaultValue) : defaultValue;
}

long CProfileConfig::ReadLong(const wxString& key, long defaultValue) const
{
    long value = defaultValue;
    if (m_config && m_config->Read(key, &value))
        return value;
    return defaultValue;
}

void CProfileConfig::WriteLong(const wxString& key, long value)
{
    if (!m_config || !m_writable)
        return;
    // The toolkit does not create the user's folder; the settings are private.
    const wxString dir = wxFileName(UserFile(m_config->GetAppName())).GetPath();
    if (!wxFileName::DirExists(dir) && !wxFileName::Mkdir(dir, 0700, wxPATH_MKDIR_FULL))
        return;
    m_config->Write(key, value);
    m_config->Flush(false);
}

wxString CProfileConfig::UserFile(const wxString& appName)
{
    wxString home;
    wxGetEnv("XDG_CONFIG_HOME", &home);
    // The XDG rules say a relative path is to be ignored.
    if (!home.StartsWith("/"))
        home = wxGetHomeDir() + "/.config";
    return SettingsFile(home, appName);
}

wxString CProfileConfig::SystemFile(const wxString& appName)
{
    wxString dirs;
    wxGetEnv("XDG_CONFIG_DIRS", &dirs);
    return SettingsFile(FirstAbsoluteDir(dirs, "/etc/xdg"), appName);
}
