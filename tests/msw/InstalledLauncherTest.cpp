// The launcher as the Windows Installer package leaves it: started from its installed
// folder (VELTRONA_INSTALLED_DIR), its window and a click that starts a module installed
// beside it, a profile opened through the shell's "Open with Veltrona", and the
// shortcuts. Run by tests/install/msi-install.sh in a Wine prefix with the packages
// installed, never on its own.
#include "support/GuiWait.h"
#include "support/ScopedEnv.h"
#include "support/StandinLog.h"
#include "support/msw/ReaderButtons.h"

#include <gtest/gtest.h>
#include <wx/dir.h>
#include <wx/filefn.h>
#include <wx/filename.h>
#include <wx/process.h>
#include <wx/stdpaths.h>
#include <wx/utils.h>

#include <windows.h>

#include <objbase.h>
#include <shlobj.h>

#include <fstream>
#include <optional>

namespace {

std::string InstalledDir()
{
    wxString dir;
    return wxGetEnv("VELTRONA_INSTALLED_DIR", &dir) ? dir.utf8_string() : std::string();
}

// The launcher's shown frame among the top-level windows of the process `pid` (or of any
// process when 0): the splash before it has no title.
HWND LauncherFrame(DWORD pid)
{
    struct Search
    {
        DWORD pid;
        HWND found;
    } search = {pid, nullptr};
    EnumWindows(
        [](HWND window, LPARAM data) -> BOOL {
            auto* search = reinterpret_cast<Search*>(data);
            DWORD owner = 0;
            GetWindowThreadProcessId(window, &owner);
            wchar_t title[32] = {};
            GetWindowTextW(window, title, 32);
            if ((search->pid == 0 || owner == search->pid) && IsWindowVisible(window) &&
                wcscmp(title, L"Veltrona") == 0) {
                search->found = window;
                return FALSE;
            }
            return TRUE;
        },
        reinterpret_cast<LPARAM>(&search));
    return search.found;
}

// Closes the launcher's frame and waits for its process to end.
bool CloseLauncher(HWND frame)
{
    DWORD pid = 0;
    GetWindowThreadProcessId(frame, &pid);
    const HANDLE process = OpenProcess(SYNCHRONIZE, FALSE, pid);
    PostMessageW(frame, WM_CLOSE, 0, 0);
    const bool ended =
        process && WaitFor([&] { return WaitForSingleObject(process, 0) == WAIT_OBJECT_0; }, 30000);
    if (process)
        CloseHandle(process);
    return ended;
}

class InstalledLauncherTest : public testing::Test
{
protected:
    void SetUp() override
    {
        ASSERT_FALSE(m_dir.empty()) << "VELTRONA_INSTALLED_DIR names the installed folder";
        ASSERT_TRUE(wxFileExists(m_dir + "\\Veltrona.exe"));
        if (wxFileExists(m_log))
            wxRemoveFile(m_log);
    }

    const std::string m_dir = InstalledDir();
    const std::string m_log =
        wxStandardPaths::Get().GetTempDir().utf8_string() + "\\installed starts.log";
    ScopedEnv m_env{{{"VELTRONA_STANDIN_LOG", m_log}, {"VELTRONA_STANDIN_EXIT", "1"}}};
};

TEST_F(InstalledLauncherTest, StartsFromItsFolderAndAClickStartsAModuleBesideIt)
{
    CoInitializeEx(nullptr, COINIT_APARTMENTTHREADED);
    // From elsewhere, so that only the launcher's own folder can lead to the module.
    wxSetWorkingDirectory(wxStandardPaths::Get().GetTempDir());
    const long pid = wxExecute("\"" + wxString::FromUTF8(m_dir) + "\\Veltrona.exe\"", wxEXEC_ASYNC);
    ASSERT_GT(pid, 0);
    HWND frame = nullptr;
    ASSERT_TRUE(WaitFor([&] { return (frame = LauncherFrame(DWORD(pid))) != nullptr; }, 60000))
        << "the installed launcher's frame";

    std::vector<ReaderButton> buttons;
    EXPECT_TRUE(WaitFor([&] {
        for (const ReaderButton& button : buttons)
            button.accessible->Release();
        buttons = ReaderButtons(frame);
        return buttons.size() == 7;
    })) << "the launcher's seven buttons through MSAA";
    for (const ReaderButton& button : buttons) {
        if (button.name == "Printer") {
            VARIANT self;
            self.vt = VT_I4;
            self.lVal = CHILDID_SELF;
            EXPECT_EQ(button.accessible->accDoDefaultAction(self), S_OK);
        }
        button.accessible->Release();
    }
    const auto records = WaitForRecords(m_log, 1, 30000);
    ASSERT_EQ(records.size(), 1u) << "the Printer stand-in's start record";
    EXPECT_EQ(records[0].exe, m_dir + "\\Quenta Print Studio.exe");
    EXPECT_EQ(records[0].cwd, m_dir);
    EXPECT_TRUE(CloseLauncher(frame)) << "the launcher's end after its frame closed";
    CoUninitialize();
}

// "Open with Veltrona" as the shell runs it for the file types' lists (`start /ProgIDOpen`):
// first the launcher starts with the file, then a second copy hands it to the running one.
TEST_F(InstalledLauncherTest, ProfileOpenedWithVeltronaReachesInspectWhole)
{
    const wxString folder = wxStandardPaths::Get().GetTempDir() + "\\colour profiles";
    wxFileName::Mkdir(folder, wxS_DIR_DEFAULT, wxPATH_MKDIR_FULL);
    const wxString profile = folder + "\\my screen.icc";
    std::ofstream(profile.fn_str()) << "profile";
    const wxString open = "start.exe /ProgIDOpen Zelgrave.Veltrona.Profile \"" + profile + "\"";

    for (const size_t started : {1u, 2u}) {
        SCOPED_TRACE(started == 1 ? "launcher started with the file" : "handed to the running one");
        const long starter = wxExecute(open, wxEXEC_ASYNC);
        ASSERT_GT(starter, 0);
        ASSERT_TRUE(WaitFor([&] { return !wxProcess::Exists(int(starter)); }, 30000))
            << "start.exe's end";
        const auto records = WaitForRecords(m_log, started, 60000);
        ASSERT_EQ(records.size(), started) << "the Inspect stand-in's start record";
        EXPECT_EQ(records.back().exe, m_dir + "\\Quenta Inspect Studio.exe");
        EXPECT_EQ(records.back().args, std::vector<std::string>{profile.utf8_string()});
    }
    HWND frame = nullptr;
    ASSERT_TRUE(WaitFor([&] { return (frame = LauncherFrame(0)) != nullptr; }))
        << "the launcher that the shell started";
    EXPECT_TRUE(CloseLauncher(frame)) << "the launcher's end after its frame closed";
    EXPECT_EQ(LauncherFrame(0), nullptr) << "a second launcher left running";
}

// The shortcut named "Veltrona" in a folder of the system's, if there is one.
std::optional<wxString> ShortcutIn(std::initializer_list<int> folders)
{
    for (const int folder : folders) {
        wchar_t path[MAX_PATH] = {};
        if (SHGetFolderPathW(nullptr, folder, nullptr, SHGFP_TYPE_CURRENT, path) == S_OK &&
            wxFileExists(wxString(path) + "\\Veltrona.lnk"))
            return wxString(path) + "\\Veltrona.lnk";
    }
    return std::nullopt;
}

// The Start menu's shortcut always, the desktop's only when asked for
// (VELTRONA_DESKTOP_SHORTCUT=1); each leads to the installed launcher, runs it in its
// folder and shows the launcher's icon. Per machine on Windows; Wine makes the user's.
TEST_F(InstalledLauncherTest, ShortcutsLeadToTheInstalledLauncher)
{
    wxString wanted;
    const bool desktopAsked = wxGetEnv("VELTRONA_DESKTOP_SHORTCUT", &wanted) && wanted == "1";
    const auto startMenu = ShortcutIn({CSIDL_COMMON_PROGRAMS, CSIDL_PROGRAMS});
    const auto desktop = ShortcutIn({CSIDL_COMMON_DESKTOPDIRECTORY, CSIDL_DESKTOPDIRECTORY});
    ASSERT_TRUE(startMenu) << "the Start menu's shortcut";
    EXPECT_EQ(desktop.has_value(), desktopAsked) << "the desktop's shortcut";

    CoInitializeEx(nullptr, COINIT_APARTMENTTHREADED);
    for (const auto& shortcut : {startMenu, desktop}) {
        if (!shortcut)
            continue;
        SCOPED_TRACE(shortcut->utf8_string());
        IShellLinkW* link = nullptr;
        ASSERT_EQ(CoCreateInstance(CLSID_ShellLink, nullptr, CLSCTX_INPROC_SERVER, IID_IShellLinkW,
                                   reinterpret_cast<void**>(&link)),
                  S_OK);
        IPersistFile* file = nullptr;
        ASSERT_EQ(link->QueryInterface(IID_IPersistFile, reinterpret_cast<void**>(&file)), S_OK);
        ASSERT_EQ(file->Load(shortcut->wc_str(), STGM_READ), S_OK);
        wchar_t target[MAX_PATH] = {}, folder[MAX_PATH] = {}, icon[MAX_PATH] = {};
        int iconIndex = -1;
        EXPECT_EQ(link->GetPath(target, MAX_PATH, nullptr, 0), S_OK);
        EXPECT_EQ(link->GetWorkingDirectory(folder, MAX_PATH), S_OK);
        EXPECT_EQ(link->GetIconLocation(icon, MAX_PATH, &iconIndex), S_OK);
        EXPECT_EQ(wxString(target).utf8_string(), m_dir + "\\Veltrona.exe");
        EXPECT_EQ(wxFileName::DirName(folder).GetFullPath(),
                  wxFileName::DirName(wxString::FromUTF8(m_dir)).GetFullPath());
        // The package's icon, which the installer keeps with the product.
        EXPECT_TRUE(wxString(icon).EndsWith("\\Veltrona.ico") && wxFileExists(icon)) << icon;
        file->Release();
        link->Release();
    }
    CoUninitialize();
}

} // namespace
