// Module launching beyond a plain click: files for Inspect, modules that are
// missing, Verify's language and its running copy, observed from the
// stand-ins' start records and the window manager.
#include "app/UserLanguage.h"
#include "frame/DragNDrop.h"
#include "frame/Veltro3AppFrame.h"
#include "frame/Veltro3MainAppStandardView.h"

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
#include <set>

namespace {

const std::string kVerify = "ZelVerifyStudio.exe";

using Args = std::vector<std::string>;

class LaunchModuleTest : public testing::Test
{
protected:
    void SetUp() override
    {
        setenv("VELTRONA_STANDIN_LOG", m_log.c_str(), 1);
        setenv("VELTRONA_STANDIN_EXIT", "1", 1);
        wxSetWorkingDirectory(m_install.Path());
        m_frame = new Veltro3AppFrame("Veltrona", wxDefaultPosition, wxDefaultSize);
        m_view = m_frame->GetStandardView();
    }

    void TearDown() override { m_frame->Destroy(); }

    std::string Exe(const std::string& name) const { return m_install.Path() + "/" + name; }

    void Click(int id)
    {
        wxCommandEvent click(wxEVT_BUTTON, id);
        m_view->ProcessWindowEvent(click);
    }

    StandinDir m_install{{"Quenta Print Studio.exe", "Monitor/Zel Display Studio.exe",
                          "Quenta Link Studio.exe", kVerify, "Quenta Inspect Studio.exe",
                          "Quenta Edit Studio.exe"}};
    const std::string m_log = m_install.Path() + "/starts.log";
    Veltro3AppFrame* m_frame = nullptr;
    Veltro3MainAppStandardView* m_view = nullptr;
};

TEST_F(LaunchModuleTest, FileReachesInspectAsOneArgument)
{
    const std::string awkward = m_install.Path() + "/dir with blanks/a \"b\" c.icc";
    m_frame->OpenInInspect(wxString::FromUTF8(awkward));
    wxArrayString dropped;
    for (const char* name : {"/tmp/first.icc", "/tmp/second.icc", "/tmp/third.icc"})
        dropped.Add(name);
    EXPECT_TRUE(DragNDrop(m_view, 1005).OnDropFiles(0, 0, dropped));

    std::multiset<Args> opened;
    for (const StandinRecord& record : SettledRecords(m_log))
        opened.insert(record.args);
    EXPECT_EQ(opened, (std::multiset<Args>{{awkward}, {"/tmp/first.icc"}}))
        << "one start per opened file, with its path as one argument";
}

TEST_F(LaunchModuleTest, NothingStartsAndNothingShowsWhenThereIsNothingToStart)
{
    wxRemoveFile(Exe("Quenta Edit Studio.exe"));
    wxRemoveFile(Exe(kVerify));
    DialogRecorder dialogs;
    m_view->LaunchModule(999, wxString());
    m_frame->ProcessCommand(1006);
    Click(1105);
    // Modules are looked up in the working directory, not beside the launcher.
    StandinDir elsewhere({});
    wxSetWorkingDirectory(elsewhere.Path());
    m_frame->ProcessCommand(1001);

    EXPECT_TRUE(SettledRecords(m_log).empty());
    EXPECT_TRUE(dialogs.Dialogs().empty());
}

// From the user's locale as start-up reads it; ja.UTF-8 and de_XX are not
// installed, and still name Japanese and German.
TEST(ModuleLanguage, VerifyGetsTheWindowsNumberOfTheUsersLanguage)
{
    const std::pair<const char*, int> cases[] = {
        {"it_IT", 1040}, {"it_CH", 1040}, {"ja_JP", 1041}, {"ja", 1041},    {"de_AT", 1031},
        {"de_XX", 1031}, {"nl_NL", 1043}, {"nl_BE", 1043}, {"fr_CA", 1036}, {"es_MX", 1034},
        {"en_GB", 2057}, {"en_US", 1033}, {"pt_BR", 1046}, {"pt_PT", 1033}, {"ko_KR", 1033},
        {"zh_CN", 2052}, {"zh_TW", 1033}, {"C", 1033},
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
    ASSERT_GT(pid, 0);
    ASSERT_TRUE(WaitFor([&] { return wxFileExists(ready); }));
    unsigned long verifyWindow = 0;
    std::ifstream(ready) >> verifyWindow;

    auto activateLauncher = [&] {
        return WaitFor([&] {
            m_frame->Raise();
            return ActiveWindow() != 0 && ActiveWindow() != verifyWindow;
        });
    };
    m_frame->Show();
    ASSERT_TRUE(activateLauncher());
    m_frame->ProcessCommand(1004);
    EXPECT_TRUE(WaitFor([&] { return ActiveWindow() == verifyWindow; }));
    EXPECT_TRUE(SettledRecords(m_log, pid).empty());

    // Without the Verify executable nothing happens, not even the raise.
    wxRemoveFile(Exe(kVerify));
    ASSERT_TRUE(activateLauncher());
    Click(1105);
    EXPECT_TRUE(SettledRecords(m_log, pid).empty());
    EXPECT_NE(ActiveWindow(), verifyWindow);
    wxKill(pid, wxSIGKILL);
}

} // namespace
