// Module launching beyond a plain click: drops, missing modules, Verify's language and copy.
#include "frame/DragNDrop.h"
#include "frame/Veltro3AppFrame.h"
#include "frame/Veltro3MainAppStandardView.h"
#include "platform/UserLanguage.h"

#include "support/DesktopTools.h"
#include "support/DialogRecorder.h"
#include "support/GuiWait.h"
#include "support/ScopedEnv.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gtest/gtest.h>
#include <wx/filefn.h>
#include <wx/utils.h>

#include <fstream>

namespace {

const std::string kVerify = "ZelVerifyStudio.exe";

class LaunchModuleTest : public testing::Test
{
protected:
    void SetUp() override
    {
        setenv("VELTRONA_STANDIN_LOG", m_log.c_str(), 1);
        setenv("VELTRONA_STANDIN_EXIT", "1", 1);
        wxSetWorkingDirectory(m_install.Path());
        m_frame = new Veltro3AppFrame("Veltrona", wxDefaultPosition, wxDefaultSize);
    }
    void TearDown() override { m_frame->Destroy(); }

    StandinDir m_install{{"Quenta Edit Studio.exe", kVerify, "Quenta Inspect Studio.exe"}};
    const std::string m_log = m_install.Path() + "/starts.log";
    Veltro3AppFrame* m_frame = nullptr;
};

// A drop of several files opens the first in Inspect. Missing modules start nothing
// and show nothing.
TEST_F(LaunchModuleTest, DropsReachInspectAndMissingModulesStartNothing)
{
    const wxString names[] = {"/tmp/first.icc", "/tmp/second.icc"};
    EXPECT_TRUE(DragNDrop(m_frame->GetStandardView(), 1005).OnDropFiles(0, 0, {2, names}));
    const auto dropped = SettledRecords(m_log);
    ASSERT_EQ(dropped.size(), 1u);
    EXPECT_EQ(dropped[0].args, std::vector<std::string>{"/tmp/first.icc"});

    DialogRecorder dialogs;
    wxRemoveFile(m_install.Path() + "/Quenta Edit Studio.exe");
    m_frame->GetStandardView()->LaunchModule(999, wxString());
    m_frame->ProcessCommand(1006);
    // Modules are looked up in the working directory, not beside the launcher.
    StandinDir elsewhere({});
    wxSetWorkingDirectory(elsewhere.Path());
    m_frame->ProcessCommand(1005);
    EXPECT_EQ(SettledRecords(m_log).size(), 1u);
    EXPECT_TRUE(dialogs.Dialogs().empty());
}

// From the user's locale as start-up reads it, installed or not.
TEST(ModuleLanguage, VerifyGetsTheWindowsNumberOfTheUsersLanguage)
{
    const std::pair<const char*, int> cases[] = {
        {"it_CH", 1040}, {"ja", 1041},    {"de_XX", 1031}, {"fr_CA", 1036}, {"en_GB", 2057},
        {"pt_BR", 1046}, {"pt_PT", 1033}, {"zh_CN", 2052}, {"zh_TW", 1033}, {"C", 1033},
    };
    for (const char* name : {"LANGUAGE", "LC_ALL", "LC_MESSAGES"})
        unsetenv(name);
    for (const auto& [lang, number] : cases) {
        setenv("LANG", (lang + std::string(".UTF-8")).c_str(), 1);
        DecideUserLanguage();
        EXPECT_EQ(GetModuleLanguageId(), number) << lang;
    }
}

TEST_F(LaunchModuleTest, RunningVerifyIsBroughtForwardInsteadOfStarted)
{
    StandinDir other({kVerify});
    const std::string ready = other.Path() + "/ready";
    long pid = 0;
    {
        ScopedEnv env({{"VELTRONA_STANDIN_LOG", ready + ".log"},
                       {"VELTRONA_STANDIN_EXIT", "0"},
                       {"VELTRONA_STANDIN_READY", ready}});
        pid = wxExecute(wxString(other.Path() + "/" + kVerify), wxEXEC_ASYNC);
    }
    ASSERT_TRUE(pid > 0 && WaitFor([&] { return wxFileExists(ready); }));
    unsigned long verifyWindow = 0;
    std::ifstream(ready) >> verifyWindow;

    m_frame->Show();
    // The second time without the Verify executable: nothing happens, not even the raise.
    for (const bool installed : {true, false}) {
        if (!installed)
            wxRemoveFile(m_install.Path() + "/" + kVerify);
        ASSERT_TRUE(WaitFor([&] {
            m_frame->Raise();
            return ActiveWindow() != 0 && ActiveWindow() != verifyWindow;
        }));
        m_frame->ProcessCommand(1004);
        EXPECT_EQ(WaitFor([&] { return ActiveWindow() == verifyWindow; }, 3000), installed);
        EXPECT_TRUE(SettledRecords(m_log, pid).empty());
    }
    wxKill(pid, wxSIGKILL);
}

} // namespace
