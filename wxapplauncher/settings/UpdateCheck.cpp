#include "settings/UpdateCheck.h"

#include "platform/ProcessStart.h"
#include "settings/CProfileConfig.h"

#include <wx/datetime.h>
#include <wx/dir.h>
#include <wx/filename.h>
#include <wx/process.h>

#include <sys/stat.h>
#include <unistd.h>

namespace {

const wxString kStoreName = "Zel Updater";
const wxString kUpdaterName = "Quenta Updater.exe";
const wxString kTempPrefix = "ZELUPDATE_";
const wxString kNextLaunch = "Next Launch";
const wxString kSilent = "Silent";
const wxString kNever = "Never";
const long kSilentMissing = -1;

// "Silent" tells the updater how it was started; a value the updater never
// created is not created here either.
void MarkStart(CProfileConfig& config, long silent)
{
    if (config.ReadLong(kSilent, kSilentMissing) != kSilentMissing)
        config.WriteLong(kSilent, silent);
}

void StartUpdater()
{
    // By its full path in the launcher's folder (the working directory): a
    // bare name would be looked up on PATH instead.
    const wxArrayString argv(1, wxFileName(wxGetCwd(), kUpdaterName).GetFullPath());
    // A missing updater is not reported; nothing is started in vain.
    if (!wxFileName::FileExists(argv[0]))
        return;
    wxProcess* process = new wxProcess(nullptr, wxID_ANY);
    if (StartProcess(argv, process) == 0)
        delete process;
}

// True once the local date has reached `nextLaunch`. Only "Never" turns the
// start off; anything that is not a whole ISO date counts as due.
bool UpdateIsDue(const wxString& nextLaunch)
{
    if (nextLaunch == kNever)
        return false;
    wxDateTime day;
    if (!day.ParseISODate(nextLaunch) || !day.IsValid())
        return true;
    return wxDateTime::Now() >= day;
}

} // namespace

void RemoveUpdaterTempFiles()
{
    const wxString dir = wxFileName::GetTempDir();
    wxArrayString files;
    if (!wxDir::Exists(dir) || wxDir::GetAllFiles(dir, &files, kTempPrefix + "*", wxDIR_FILES) == 0)
        return;
    for (const wxString& file : files) {
        // A shared temporary directory may hold other users' files and links
        // planted under the updater's names.
        struct stat info;
        if (lstat(file.fn_str(), &info) == 0 && S_ISREG(info.st_mode) && info.st_uid == getuid())
            unlink(file.fn_str());
    }
}

void CheckForUpdateAtLaunch()
{
    {
        CProfileConfig config(kStoreName);
        if (!UpdateIsDue(config.ReadString(kNextLaunch, wxDateTime::Today().FormatISODate())))
            return;
        MarkStart(config, 1);
    }
    StartUpdater();
}

void CheckForUpdatesNow()
{
    {
        CProfileConfig config(kStoreName);
        MarkStart(config, 0);
    }
    StartUpdater();
}
