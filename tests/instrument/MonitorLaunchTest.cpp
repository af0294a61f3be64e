// The instrument precondition of the Monitor module: the module starts unless
// an instrument answers and sits on its measuring table, in which case a
// message is shown instead; without a usable library the module starts.
#include "frame/Veltro3AppFrame.h"
#include "frame/Veltro3MainAppStandardView.h"
#include "instrument/VaroFunctions.h"
#include "instrument/VaroSimControl.h"
#include "instrument/Varo_client.h"
#include "platform/VaroLibrary.h"

#include "support/DialogRecorder.h"
#include "support/GuiWait.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gtest/gtest.h>
#include <wx/filefn.h>
#include <wx/filename.h>
#include <wx/stdpaths.h>
#include <wx/utils.h>

#include <cstdlib>
#include <memory>

namespace {

const char kMonitor[] = "Monitor/Zel Display Studio.exe";
const char kPrinter[] = "Quenta Print Studio.exe";
const char kOnTableMessage[] = "Please remove the Zel Varo from the Orbis table.\nConnect directly "
                               "to the Zel Varo and try again.";

class MonitorLaunch : public testing::Test
{
protected:
    void Install(const std::vector<std::string>& names)
    {
        m_install = std::make_unique<StandinDir>(names);
        m_log = m_install->Path() + "/starts.log";
        setenv("VELTRONA_STANDIN_LOG", m_log.c_str(), 1);
        setenv("VELTRONA_STANDIN_EXIT", "1", 1);
        wxSetWorkingDirectory(m_install->Path());
        m_frame = new Veltro3AppFrame("Veltrona", wxDefaultPosition, wxDefaultSize);
        m_view = m_frame->GetStandardView();
    }

    void TearDown() override
    {
        if (m_frame)
            m_frame->Destroy();
        wxSetWorkingDirectory("/");
    }

    // Monitor's start, seen in the stand-ins' log; no client outlives the launch.
    void ExpectMonitorStarts()
    {
        m_view->LaunchModule(1002, wxString());
        EXPECT_TRUE(Varo_client::s_clients.empty());
        const std::vector<StandinRecord> records = WaitForRecords(m_log, 1);
        ASSERT_EQ(records.size(), 1u);
        EXPECT_EQ(records[0].exe, Exe(kMonitor));
        EXPECT_TRUE(m_dialogs.Dialogs().empty());
    }

    // Starts Printer after the Monitor request and waits for it; by then a
    // Monitor started by the request would normally have recorded its start.
    void ExpectOnlyPrinterStarts()
    {
        EXPECT_TRUE(Varo_client::s_clients.empty());
        m_view->LaunchModule(1001, wxString());
        std::vector<StandinRecord> records;
        EXPECT_TRUE(WaitFor([&] {
            records = ReadRecords(m_log);
            return !records.empty();
        }));
        for (const StandinRecord& record : records)
            EXPECT_EQ(record.exe, Exe(kPrinter));
    }

    std::string Exe(const std::string& name) const { return m_install->Path() + "/" + name; }

    DialogRecorder m_dialogs;
    std::unique_ptr<StandinDir> m_install;
    std::string m_log;
    Veltro3AppFrame* m_frame = nullptr;
    Veltro3MainAppStandardView* m_view = nullptr;
};

class MonitorWithSimulator : public MonitorLaunch
{
protected:
    VaroSimControl m_sim;
};

TEST_F(MonitorWithSimulator, NoInstrumentStartsTheModuleWithoutAskingForTheTable)
{
    m_sim.SetState(VAROSIM_NONE);
    Install({kMonitor, kPrinter});
    ExpectMonitorStarts();
    EXPECT_EQ(m_sim.Calls("VaroCheckInstrument"), 1);
    EXPECT_EQ(m_sim.Calls("VaroCheckTableMount"), 0);
}

TEST_F(MonitorWithSimulator, InstrumentAttachedDirectlyStartsTheModule)
{
    m_sim.SetState(VAROSIM_DIRECT);
    Install({kMonitor, kPrinter});
    ExpectMonitorStarts();
    EXPECT_EQ(m_sim.Calls("VaroCheckTableMount"), 1);
}

TEST_F(MonitorWithSimulator, InstrumentOnTheTableShowsTheMessageAndStartsNothing)
{
    m_sim.SetState(VAROSIM_TABLE);
    Install({kMonitor, kPrinter});
    wxCommandEvent press(wxEVT_BUTTON, 1100);
    m_view->ProcessWindowEvent(press);
    m_view->LaunchModule(1002, wxString());
    ExpectOnlyPrinterStarts();

    ASSERT_EQ(m_dialogs.Dialogs().size(), 2u);
    for (const RecordedDialog& dialog : m_dialogs.Dialogs()) {
        EXPECT_EQ(dialog.message, kOnTableMessage);
        EXPECT_EQ(dialog.caption, "Message");
        EXPECT_EQ(dialog.style & (wxOK | wxCENTRE | wxCANCEL | wxYES_NO), wxOK | wxCENTRE);
    }
}

TEST_F(MonitorWithSimulator, TableMessageAlsoShowsWhenTheModuleIsMissing)
{
    m_sim.SetState(VAROSIM_TABLE);
    Install({kPrinter});
    m_view->LaunchModule(1002, wxString());
    ExpectOnlyPrinterStarts();
    ASSERT_EQ(m_dialogs.Dialogs().size(), 1u);
    EXPECT_EQ(m_dialogs.Dialogs()[0].message, kOnTableMessage);
}

// Runs one disabled test of this binary from a copy in a directory of its
// own, so that the launcher's directory holds only what the test puts there.
class MonitorWithoutSimulator : public testing::Test
{
protected:
    void SetUp() override
    {
        char pattern[] = "/tmp/varo-child.XXXXXX";
        ASSERT_NE(mkdtemp(pattern), nullptr);
        m_dir = pattern;
        m_copy = m_dir + "/veltrona_tests";
        ASSERT_TRUE(wxCopyFile(wxStandardPaths::Get().GetExecutablePath(), m_copy));
    }

    void TearDown() override { wxFileName::Rmdir(m_dir, wxPATH_RMDIR_RECURSIVE); }

    int RunChild(bool libraryPresent)
    {
        setenv("VARO_CHILD_EXPECTS_LIBRARY", libraryPresent ? "1" : "0", 1);
        const wxString filter = "--gtest_filter=MonitorLaunch.DISABLED_StartsTheModule";
        const char* argv[] = {m_copy.c_str(), filter.c_str(), "--gtest_also_run_disabled_tests",
                              nullptr};
        return static_cast<int>(wxExecute(argv, wxEXEC_SYNC));
    }

    std::string m_dir;
    std::string m_copy;
};

TEST_F(MonitorWithoutSimulator, NoLibraryStartsTheModule)
{
    EXPECT_EQ(RunChild(false), 0);
}

TEST_F(MonitorWithoutSimulator, LibraryMissingAFunctionCountsAsNoInstrument)
{
    ASSERT_TRUE(wxCopyFile(VELTRONA_VARO_PARTIAL_PATH, m_dir + "/libvaro.so"));
    EXPECT_EQ(RunChild(true), 0);
}

TEST_F(MonitorLaunch, DISABLED_StartsTheModule)
{
    const bool libraryPresent = std::getenv("VARO_CHILD_EXPECTS_LIBRARY") == std::string("1");
    Install({kMonitor, kPrinter});
    ExpectMonitorStarts();
    EXPECT_EQ(VaroLibrary::Get().IsLoaded(), libraryPresent);
    EXPECT_EQ(VaroFunctions::Get(), nullptr);
    Varo_client client;
    EXPECT_NE(client.CheckInstrument(), 0);
    EXPECT_NE(client.CheckTableMount(), 0);
}

} // namespace
