// Module launching through the frame's menu, the view's buttons, the Inspect
// drop target and OpenInInspect, observed from the stand-ins' start records.
#include "frame/DragNDrop.h"
#include "frame/ModuleCatalog.h"
#include "frame/Veltro3AppFrame.h"
#include "frame/Veltro3MainAppStandardView.h"

#include "support/DialogRecorder.h"
#include "support/GuiWait.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"
#include "support/X11Client.h"

#include <gtest/gtest.h>
#include <wx/filename.h>

#include <cstdlib>
#include <fstream>
#include <memory>

namespace {

const std::vector<std::string> kAllModules = {
    "Quenta Print Studio.exe", "Monitor/Zel Display Studio.exe", "Quenta Link Studio.exe",
    "ZelVerifyStudio.exe",     "Quenta Inspect Studio.exe",      "Quenta Edit Studio.exe",
};

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
        wxSetWorkingDirectory("/");
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

    std::vector<StandinRecord> WaitForStarts(size_t count)
    {
        return WaitForRecords(m_log, count, 10000);
    }

    // Starts Printer and waits for it: everything asked to start before it has
    // been started by then.
    std::vector<StandinRecord> StartsBeforeSentinel()
    {
        const size_t before = ReadRecords(m_log).size();
        Click(1101);
        std::vector<StandinRecord> records;
        WaitFor([&] {
            records = ReadRecords(m_log);
            return records.size() > before && records.back().exe == Exe("Quenta Print Studio.exe");
        });
        EXPECT_FALSE(records.empty());
        if (!records.empty())
            records.pop_back();
        return records;
    }

    std::unique_ptr<StandinDir> m_install;
    std::string m_log;
    Veltro3AppFrame* m_frame = nullptr;
    Veltro3MainAppStandardView* m_view = nullptr;
};

TEST_F(LaunchModuleTest, ButtonAndMenuStartTheSameCommandLine)
{
    Install(kAllModules);
    const struct
    {
        int button, menu;
        std::string exe;
        std::vector<std::string> args;
    } cases[] = {
        {1101, 1001, "Quenta Print Studio.exe", {}},
        {1100, 1002, "Monitor/Zel Display Studio.exe", {}},
        {1102, 1003, "Quenta Link Studio.exe", {}},
        {1105, 1004, "ZelVerifyStudio.exe", {"VLT", std::to_string(GetModuleLanguageId())}},
        {1104, 1005, "Quenta Inspect Studio.exe", {}},
        {1103, 1006, "Quenta Edit Studio.exe", {}},
    };
    size_t expected = 0;
    for (const auto& c : cases) {
        Click(c.button);
        Menu(c.menu);
        expected += 2;
        const auto records = WaitForStarts(expected);
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
    const std::string second = m_install->Path() + "/second.icc";

    m_frame->OpenInInspect(wxString::FromUTF8(awkward));
    DragNDrop drop(m_view, 1005);
    wxArrayString dropped;
    dropped.Add(wxString::FromUTF8(second));
    dropped.Add("/tmp/third.icc");
    dropped.Add("/tmp/fourth.icc");
    EXPECT_TRUE(drop.OnDropFiles(0, 0, dropped));

    const auto records = WaitForStarts(2);
    ASSERT_EQ(records.size(), 2u);
    EXPECT_EQ(records[0].args, std::vector<std::string>{awkward});
    EXPECT_EQ(records[1].args, std::vector<std::string>{second});
    EXPECT_TRUE(StartsBeforeSentinel().size() == 2) << "a drop starts Inspect once";

    // What the launcher shows as the command line keeps the plain quoting.
    const ModuleCommand command =
        BuildModuleCommand(*FindModule(1005), "/opt/suite/", wxString::FromUTF8(awkward));
    EXPECT_EQ(command.CommandLine(),
              "\"/opt/suite/Quenta Inspect Studio.exe\" \"" + wxString::FromUTF8(awkward) + "\"");
}

TEST_F(LaunchModuleTest, NothingStartsAndNothingShowsWhenThereIsNothingToStart)
{
    Install({"Quenta Print Studio.exe"});
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

    EXPECT_TRUE(StartsBeforeSentinel().empty());
    EXPECT_TRUE(dialogs.Dialogs().empty());
}

TEST_F(LaunchModuleTest, VerifyGetsTheWindowsLanguageNumber)
{
    Install(kAllModules);
    const struct
    {
        wxLanguage language;
        int number;
    } cases[] = {
        {wxLANGUAGE_ENGLISH_US, 1033},
        {wxLANGUAGE_ENGLISH_UK, 2057},
        {wxLANGUAGE_PORTUGUESE_BRAZILIAN, 1046},
        {wxLANGUAGE_PORTUGUESE, 1033},
        {wxLANGUAGE_KOREAN, 1033},
        {wxLANGUAGE_GERMAN_AUSTRIAN, 1031},
        {wxLANGUAGE_FRENCH_CANADIAN, 1036},
        {wxLANGUAGE_DUTCH_BELGIAN, 1043},
        {wxLANGUAGE_ITALIAN_SWISS, 1040},
        {wxLANGUAGE_SPANISH_MEXICAN, 1034},
        {wxLANGUAGE_JAPANESE, 1041},
        {wxLANGUAGE_CHINESE_SIMPLIFIED, 2052},
        {wxLANGUAGE_CHINESE_TRADITIONAL, 1033},
    };
    for (const auto& c : cases) {
        wxLocale locale;
        locale.Init(c.language, wxLOCALE_DONT_LOAD_DEFAULT);
        EXPECT_EQ(GetModuleLanguageId(), c.number) << wxLocale::GetLanguageName(c.language);
    }

    wxLocale british;
    british.Init(wxLANGUAGE_ENGLISH_UK, wxLOCALE_DONT_LOAD_DEFAULT);
    Click(1105);
    const auto records = WaitForStarts(1);
    ASSERT_EQ(records.size(), 1u);
    EXPECT_EQ(records[0].args, (std::vector<std::string>{"VLT", "2057"}));
}

TEST_F(LaunchModuleTest, RunningVerifyIsBroughtForwardInsteadOfStarted)
{
    Install(kAllModules);
    StandinDir verifyInstall({"ZelVerifyStudio.exe"});
    const std::string ready = verifyInstall.Path() + "/ready";
    const std::string verifyLog = verifyInstall.Path() + "/verify.log";
    wxExecuteEnv env;
    wxGetEnvMap(&env.env);
    env.env["VELTRONA_STANDIN_EXIT"] = "0";
    env.env["VELTRONA_STANDIN_READY"] = ready;
    env.env["VELTRONA_STANDIN_LOG"] = verifyLog;
    const wxString verifyExe = verifyInstall.Path() + "/ZelVerifyStudio.exe";
    const wchar_t* argv[] = {verifyExe.wc_str(), nullptr};
    const long pid = wxExecute(argv, wxEXEC_ASYNC, nullptr, &env);
    ASSERT_GT(pid, 0);
    ASSERT_TRUE(WaitFor([&] { return wxFileExists(ready); }));
    std::ifstream readyFile(ready);
    unsigned long verifyWindow = 0;
    readyFile >> verifyWindow;

    // Another window has the focus when Verify is pressed.
    m_frame->Show();
    X11Client x11;
    ASSERT_TRUE(WaitFor([&] {
        m_frame->Raise();
        return x11.ActiveWindow() != 0 && x11.ActiveWindow() != verifyWindow;
    }));

    Menu(1004);
    EXPECT_TRUE(WaitFor([&] { return x11.ActiveWindow() == verifyWindow; }));
    EXPECT_TRUE(StartsBeforeSentinel().empty());

    // Without the Verify executable nothing happens, not even the raise.
    wxRemoveFile(Exe("ZelVerifyStudio.exe"));
    ASSERT_TRUE(WaitFor([&] {
        m_frame->Raise();
        return x11.ActiveWindow() != verifyWindow;
    }));
    Click(1105);
    EXPECT_TRUE(StartsBeforeSentinel().size() == 1); // the earlier sentinel only
    EXPECT_NE(x11.ActiveWindow(), verifyWindow);

    wxKill(pid, wxSIGKILL);
}

} // namespace
