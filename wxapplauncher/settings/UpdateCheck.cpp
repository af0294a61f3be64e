#include "settings/UpdateCheck.h"

#include "platform/ProcessStart.h"
#include "settings/CProfileConfig.h"

#include <wx/datetime.h>
#include <wx/dir.h>
#include <wx/filename.h>
#include <wx/process.h>

#include <csignal>
#include <fcntl.h>
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

void RemoveUpdaterTempFiles()
{
    const wxString dir = wxFileName::GetTempDir();
    wxArrayString files;
    if (!wxDir::Exists(dir) || wxDir::GetAllFiles(dir, &files, kTempPrefix + "*", wxDIR_FILES) == 0)
        return;
    for (const wxString& file : files) {
        // A shared temporary directory may hold other users' files and links
        // planted under the updater's names. A file that a running updater
        // holds open stays: on Windows it could not be deleted either.
        const int fd = open(file.fn_str(), O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC);
        if (fd < 0)
            continue;
        struct stat info;
        if (fstat(fd, &info) == 0 && S_ISREG(info.st_mode) && info.st_uid == getuid() &&
            TakeLeaseIfUnused(fd)) {
            unlink(file.fn_str());
            fcntl(fd, F_SETLEASE, F_UNLCK);
        }
        close(fd);
    }
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
