#include "settings/UpdateCheck.h"

#include "platform/FileRemoval.h"
#include "platform/ProcessStart.h"
#include "settings/CProfileConfig.h"

#include <wx/datetime.h>
#include <wx/dir.h>
#include <wx/filename.h>

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
    const wxString path = wxFileName(wxGetCwd(), kUpdaterName).GetFullPath();
    // A missing updater is not reported; nothing is started in vain.
    if (wxFileName::FileExists(path))
        StartProgram(path);
}

// True once the local date has reached the day of `nextLaunch`; a time after
// the day ("2099-12-31 12:00", "2099-12-31T00:00:00") is part of the date. Only
// "Never" turns the start off; anything else that is not such a date counts as due.
bool UpdateIsDue(const wxString& nextLaunch)
{
    if (nextLaunch == kNever)
        return false;
    wxDateTime day, time;
    wxString::const_iterator end;
    if (!day.ParseFormat(nextLaunch, "%Y-%m-%d", &end) || !day.IsValid())
        return true;
    if (end != nextLaunch.end()) {
        const wxString clock(end + 1, nextLaunch.end());
        wxString::const_iterator clockEnd;
        if ((*end != ' ' && *end != 'T') || !time.ParseTime(clock, &clockEnd) ||
            clockEnd != clock.end())
            return true;
    }
    return wxDateTime::Now() >= day;
}

} // namespace

void RemoveUpdaterTempFiles()
{
    const wxString dir = wxFileName::GetTempDir();
    wxArrayString files;
    if (!wxDir::Exists(dir) || wxDir::GetAllFiles(dir, &files, kTempPrefix + "*", wxDIR_FILES) == 0)
        return;
    // A shared temporary directory may hold other users' files and links
    // planted under the updater's names. A file that a running updater holds
    // open stays.
    for (const wxString& file : files)
        RemoveFileIfUnused(file);
}

void CheckForUpdateAtLaunch()
{
    {
        CProfileConfig config(kStoreName);
        // The updater records its next date in the same file; from a file the
        // launcher cannot write it would be started, unmarked, at every launch.
        if (!config.IsWritable() ||
            !UpdateIsDue(config.ReadString(kNextLaunch, wxDateTime::Today().FormatISODate())))
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
