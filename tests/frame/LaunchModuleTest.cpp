// Module launching through the File menu, the view's buttons, the Inspect drop
// target and OpenInInspect, observed from the stand-ins' start records.
#include "app/UserLanguage.h"
#include "frame/DragNDrop.h"
#include "frame/ModuleCatalog.h"
#include "frame/Veltro3AppFrame.h"
#include "frame/Veltro3MainAppStandardView.h"

#include "support/DesktopTools.h"
#include "support/DialogRecorder.h"
#include "support/GuiWait.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gtest/gtest.h>
#include <wx/filefn.h>
#include <wx/utils.h>

#include <fstream>
#include <memory>
#include <set>

namespace {

const std::string kPrinter = "Quenta Print Studio.exe";
const std::string kVerify = "ZelVerifyStudio.exe";
const std::vector<std::string> kAllModules = {
    kPrinter, "Monitor/Zel Display Studio.exe", "Quenta Link Studio.exe",
    kVerify,  "Quenta Inspect Studio.exe",      "Quenta Edit Studio.exe",
};

using Args = std::vector<std::string>;

class LaunchModuleTest : public testing::Test
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
    }

    std::string Exe(const std::string& name) const { return m_install->Path() + "/" + name; }

    void Click(int buttonId)
    {
        wxCommandEvent click(wxEVT_BUTTON, buttonId);
        m_view->ProcessWindowEvent(click);
    }

    void Menu(int commandId)
    {
        wxCommandEvent command(wxEVT_MENU, commandId);
        m_frame->ProcessWindowEvent(command);
    }

    std::unique_ptr<StandinDir> m_install;
    std::string m_log;
    Veltro3AppFrame* m_frame = nullptr;
    Veltro3MainAppStandardView* m_view = nullptr;
};

TEST_F(LaunchModuleTest, ButtonAndMenuStartTheSameProgramWithTheSameArguments)
{
    Install(kAllModules);
    const struct
    {
        int button, menu;
        std::string exe;
        Args args;
    } cases[] = {
        {1101, 1001, kPrinter, {}},
        {1100, 1002, "Monitor/Zel Display Studio.exe", {}},
        {1102, 1003, "Quenta Link Studio.exe", {}},
        {1105, 1004, kVerify, {"VLT", std::to_string(GetModuleLanguageId())}},
        {1104, 1005, "Quenta Inspect Studio.exe", {}},
        {1103, 1006, "Quenta Edit Studio.exe", {}},
    };
    size_t expected = 0;
    for (const auto& c : cases) {
        Click(c.button);
        Menu(c.menu);
        expected += 2;
        const auto records = WaitForRecords(m_log, expected);
        ASSERT_EQ(records.size(), expected) << c.exe;
        for (size_t i = expected - 2; i < expected; ++i) {
            EXPECT_EQ(records[i].exe, Exe(c.exe));
            EXPECT_EQ(records[i].args, c.args) << c.exe;
            EXPECT_EQ(records[i].cwd, m_install->Path());
        }
    }
}

TEST_F(LaunchModuleTest, FileReachesInspectAsOneArgument)
{
    Install(kAllModules);
    const std::string awkward = m_install->Path() + "/dir with blanks/a \"b\" c.icc";
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

    // The command line shown for it keeps the plain quoting.
    const ModuleCommand command = BuildModuleCommand(*FindModule(1005), "/opt/suite/", "a b.icc");
    EXPECT_EQ(command.CommandLine(), "\"/opt/suite/Quenta Inspect Studio.exe\" \"a b.icc\"");
}

TEST_F(LaunchModuleTest, NothingStartsAndNothingShowsWhenThereIsNothingToStart)
{
    Install({kPrinter});
    DialogRecorder dialogs;
    m_view->LaunchModule(999, wxString());
    m_view->LaunchModule(1000, wxString());
    Menu(1006);  // Edit is not installed
    Click(1105); // nor is Verify

    // Modules are looked up in the working directory, not beside the launcher.
    StandinDir elsewhere({});
    wxSetWorkingDirectory(elsewhere.Path());
    Menu(1001);
    wxSetWorkingDirectory(m_install->Path());

    EXPECT_TRUE(SettledRecords(m_log).empty());
    EXPECT_TRUE(dialogs.Dialogs().empty());
}

// From the user's locale as start-up reads it; ja.UTF-8 and de_XX are not
// installed, and still name Japanese and German.
TEST_F(LaunchModuleTest, VerifyGetsTheWindowsNumberOfTheUsersLanguage)
{
    Install(kAllModules);
    const struct
    {
        const char* lang;
        int number;
    } cases[] = {
        {"it_IT", 1040}, {"ja_JP", 1041}, {"ja", 1041},    {"it_CH", 1040}, {"de_DE", 1031},
        {"de_AT", 1031}, {"nl_NL", 1043}, {"nl_BE", 1043}, {"fr_FR", 1036}, {"fr_CA", 1036},
        {"es_ES", 1034}, {"es_MX", 1034}, {"en_GB", 2057}, {"en_US", 1033}, {"pt_BR", 1046},
        {"pt_PT", 1033}, {"ko_KR", 1033}, {"zh_CN", 2052}, {"zh_TW", 1033}, {"de_XX", 1031},
        {"C", 1033},
    };
    for (const char* name : {"LANGUAGE", "LC_ALL", "LC_MESSAGES"})
        unsetenv(name);
    for (const auto& c : cases) {
        setenv("LANG", (c.lang + std::string(".UTF-8")).c_str(), 1);
        DecideUserLanguage();
        EXPECT_EQ(GetModuleLanguageId(), c.number) << c.lang;
    }

    setenv("LANG", "en_GB.UTF-8", 1);
    DecideUserLanguage();
    Click(1105);
    const auto records = WaitForRecords(m_log, 1);
    ASSERT_EQ(records.size(), 1u);
    EXPECT_EQ(records[0].args, (Args{"VLT", "2057"}));
}

TEST_F(LaunchModuleTest, RunningVerifyIsBroughtForwardInsteadOfStarted)
{
    Install(kAllModules);
    StandinDir other({kVerify});
    const std::string ready = other.Path() + "/ready";
    wxExecuteEnv env;
    wxGetEnvMap(&env.env);
    env.env.erase("VELTRONA_STANDIN_LOG");
    env.env["VELTRONA_STANDIN_EXIT"] = "0";
    env.env["VELTRONA_STANDIN_READY"] = ready;
    const wxString exe = other.Path() + "/" + kVerify;
    const wchar_t* argv[] = {exe.wc_str(), nullptr};
    const long pid = wxExecute(argv, wxEXEC_ASYNC, nullptr, &env);
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
    Menu(1004);
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
