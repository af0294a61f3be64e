// The Monitor module's instrument check: the module starts unless an
// instrument answers from its measuring table, where a message shows instead;
// without a usable instrument library the module starts.
#include "frame/Veltro3AppFrame.h"
#include "frame/Veltro3MainAppStandardView.h"
#include "instrument/SimControl.h"
#include "instrument/Varo_client.h"
#include "support/DialogRecorder.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gtest/gtest.h>
#include <wx/filefn.h>
#include <wx/filename.h>
#include <wx/stdpaths.h>
#include <wx/utils.h>

#include <cstdlib>
#include <set>

namespace {

const char kMonitor[] = "Monitor/Zel Display Studio.exe";

// A launcher frame in an installation of stand-ins that log their starts.
struct Launcher
{
    Launcher() : install({kMonitor}), log(install.Path() + "/starts.log")
    {
        setenv("VELTRONA_STANDIN_LOG", log.c_str(), 1);
        setenv("VELTRONA_STANDIN_EXIT", "1", 1);
        wxSetWorkingDirectory(install.Path());
        frame = new Veltro3AppFrame("Veltrona", wxDefaultPosition, wxDefaultSize);
    }
    ~Launcher()
    {
        frame->Destroy();
        wxSetWorkingDirectory("/");
    }

    void Launch(int module) { frame->GetStandardView()->LaunchModule(module, wxString()); }
    std::string Exe(const char* name) const { return install.Path() + "/" + name; }
    // The programs started so far.
    std::multiset<std::string> Started() const
    {
        std::multiset<std::string> started;
        for (const StandinRecord& record : SettledRecords(log))
            started.insert(record.exe);
        return started;
    }

    DialogRecorder dialogs;
    StandinDir install;
    std::string log;
    Veltro3AppFrame* frame;
};

TEST(MonitorLaunch, StartsUnlessTheInstrumentIsOnTheTable)
{
    Launcher launcher;
    // On the table: the message, also where the module is missing, and no start.
    SIM(varosim_set_state)(VAROSIM_TABLE);
    wxSetWorkingDirectory("/");
    launcher.Launch(1002);
    wxSetWorkingDirectory(launcher.install.Path());
    launcher.Launch(1002);
    EXPECT_TRUE(launcher.Started().empty());
    ASSERT_EQ(launcher.dialogs.Dialogs().size(), 2u);
    for (const RecordedDialog& dialog : launcher.dialogs.Dialogs()) {
        EXPECT_EQ(dialog.message, "Please remove the Zel Varo from the Orbis table.\nConnect "
                                  "directly to the Zel Varo and try again.");
        EXPECT_EQ(dialog.caption, "Message");
        EXPECT_EQ(dialog.style & (wxOK | wxCENTRE | wxCANCEL | wxYES_NO), wxOK | wxCENTRE);
    }

    // Attached directly, or no instrument (the table is then not asked): it starts.
    SIM(varosim_set_state)(VAROSIM_DIRECT);
    launcher.Launch(1002);
    SIM(varosim_set_state)(VAROSIM_NONE);
    launcher.Launch(1002);
    const std::string monitor = launcher.Exe(kMonitor);
    EXPECT_EQ(launcher.Started(), (std::multiset<std::string>{monitor, monitor}));
    EXPECT_EQ(SIM(varosim_calls)("VaroCheckTableMount"), 3);
    EXPECT_EQ(launcher.dialogs.Dialogs().size(), 2u);
    EXPECT_TRUE(Varo_client::s_clients.empty());
}

// Run by the test below, from a copy of this binary in a directory of its own.
TEST(MonitorLaunch, DISABLED_ChildStartsTheModule)
{
    Launcher launcher;
    launcher.Launch(1002);
    EXPECT_EQ(launcher.Started(), std::multiset<std::string>{launcher.Exe(kMonitor)});
    EXPECT_TRUE(launcher.dialogs.Dialogs().empty());
    EXPECT_EQ(VaroLibrary::Get().IsLoaded(), std::getenv("VARO_EXPECT_LIBRARY") != nullptr);
}

// No library beside the launcher, then one that lacks its measure function and
// whose instrument would answer from the table.
TEST(MonitorLaunch, StartsWithoutAUsableLibrary)
{
    char dir[] = "/tmp/varo-child.XXXXXX";
    ASSERT_NE(mkdtemp(dir), nullptr);
    const std::string copy = dir + std::string("/veltrona_tests");
    ASSERT_TRUE(wxCopyFile(wxStandardPaths::Get().GetExecutablePath(), copy));
    const char* argv[] = {copy.c_str(),
                          "--gtest_filter=MonitorLaunch.DISABLED_ChildStartsTheModule",
                          "--gtest_also_run_disabled_tests", nullptr};
    EXPECT_EQ(wxExecute(argv, wxEXEC_SYNC), 0);
    ASSERT_TRUE(wxCopyFile(VELTRONA_VARO_PARTIAL_PATH, dir + std::string("/libvaro.so")));
    setenv("VARO_EXPECT_LIBRARY", "1", 1);
    setenv("VARO_SIM_STATE", "table", 1);
    EXPECT_EQ(wxExecute(argv, wxEXEC_SYNC), 0);
    wxFileName::Rmdir(dir, wxPATH_RMDIR_RECURSIVE);
}

} // namespace
