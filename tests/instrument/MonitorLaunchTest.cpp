// The Monitor module's instrument check: a message instead of the module while
// the instrument is on its measuring table; otherwise the module starts.
#include "frame/Veltro3AppFrame.h"
#include "frame/Veltro3MainAppStandardView.h"
#include "instrument/SimControl.h"
#include "instrument/Varo_client.h"
#include "support/DialogRecorder.h"
#include "support/ShownMessageBox.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gtest/gtest.h>
#include <wx/filefn.h>
#include <wx/stdpaths.h>
#include <wx/utils.h>

#include <cstdlib>
#include <functional>
#include <utility>

namespace {

// A launcher frame in an installation of the Monitor stand-in, which logs its starts.
struct Launcher
{
    // `answer` answers the dialogs the launcher shows; by default OK, unseen.
    explicit Launcher(std::function<int(wxDialog*)> answer = {}) : dialogs(std::move(answer))
    {
        setenv("VELTRONA_STANDIN_LOG", log.c_str(), 1);
        setenv("VELTRONA_STANDIN_EXIT", "1", 1);
        wxSetWorkingDirectory(install.Path());
        frame = new Veltro3AppFrame("Veltrona", wxDefaultPosition, wxDefaultSize);
    }
    ~Launcher() { frame->Destroy(), wxSetWorkingDirectory("/"); }
    void Launch() { frame->GetStandardView()->LaunchModule(1002, wxString()); }
    size_t Starts() const { return SettledRecords(log).size(); }

    DialogRecorder dialogs;
    StandinDir install{{"Monitor/Zel Display Studio.exe"}};
    std::string log = install.Path() + "/starts.log";
    Veltro3AppFrame* frame;
};

TEST(MonitorLaunch, StartsUnlessTheInstrumentIsOnTheTable)
{
    Launcher launcher;
    // On the table: the message, also where the module is missing, and no start.
    SIM(varosim_set_state)(VAROSIM_TABLE);
    wxSetWorkingDirectory("/");
    launcher.Launch();
    wxSetWorkingDirectory(launcher.install.Path());
    launcher.Launch();
    EXPECT_EQ(launcher.Starts(), 0u);
    ASSERT_EQ(launcher.dialogs.Dialogs().size(), 2u);
    for (const RecordedDialog& dialog : launcher.dialogs.Dialogs())
        EXPECT_EQ(dialog.message, "Please remove the Zel Varo from the Orbis table.\nConnect "
                                  "directly to the Zel Varo and try again.");

    // Attached directly, or no instrument: it starts.
    SIM(varosim_set_state)(VAROSIM_DIRECT);
    launcher.Launch();
    SIM(varosim_set_state)(VAROSIM_NONE);
    launcher.Launch();
    EXPECT_EQ(launcher.Starts(), 2u);
    EXPECT_EQ(launcher.dialogs.Dialogs().size(), 2u);
    EXPECT_TRUE(Varo_client::s_clients.empty());
}

// The real box on the screen carries its caption as its title.
TEST(MonitorLaunch, TableMessageShowsItsCaption)
{
    Launcher launcher([](wxDialog*) { return int(wxID_NONE); });
    SIM(varosim_set_state)(VAROSIM_TABLE);
    const ShownMessageBox box = ObserveMessageBox([&] { launcher.Launch(); });
    ASSERT_TRUE(box.seen);
    EXPECT_EQ(box.title, "Message");
    EXPECT_EQ(launcher.Starts(), 0u);
}

// Run by the test below, from a copy of this binary in a directory of its own.
TEST(MonitorLaunch, DISABLED_ChildStartsTheModule)
{
    Launcher launcher;
    launcher.Launch();
    EXPECT_EQ(launcher.Starts(), 1u);
    EXPECT_TRUE(launcher.dialogs.Dialogs().empty());
    EXPECT_EQ(VaroLibrary::Get().IsLoaded(), std::getenv("VARO_EXPECT_LIBRARY") != nullptr);
}

// No library beside the launcher, then one lacking its measure function.
TEST(MonitorLaunch, StartsWithoutAUsableLibrary)
{
    const StandinDir dir({});
    const std::string copy = dir.Path() + "/veltrona_tests";
    ASSERT_TRUE(wxCopyFile(wxStandardPaths::Get().GetExecutablePath(), copy));
    const char* argv[] = {copy.c_str(),
                          "--gtest_filter=MonitorLaunch.DISABLED_ChildStartsTheModule",
                          "--gtest_also_run_disabled_tests", nullptr};
    EXPECT_EQ(wxExecute(argv, wxEXEC_SYNC), 0);
    ASSERT_TRUE(wxCopyFile(VELTRONA_VARO_PARTIAL_PATH, dir.Path() + "/libvaro.so"));
    setenv("VARO_EXPECT_LIBRARY", "1", 1);
    setenv("VARO_SIM_STATE", "table", 1);
    EXPECT_EQ(wxExecute(argv, wxEXEC_SYNC), 0);
}

} // namespace
