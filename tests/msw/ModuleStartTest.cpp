// Modules as the stand-ins receive them on Windows: each button clicked through its
// window's own messages, pressed with Space, its File command, or a screen reader's
// default action through MSAA, from an installation folder with a blank in its path;
// and the Verify raise through FindWindowW.
#include "controls/ZelStaticBitmap.h"
#include "frame/DragNDrop.h"
#include "frame/Veltro3AppFrame.h"
#include "frame/Veltro3MainAppStandardView.h"
#include "platform/UserLanguage.h"
#include "support/DialogRecorder.h"
#include "support/GuiWait.h"
#include "support/ProbeRun.h"
#include "support/ScopedEnv.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"
#include "support/msw/ReaderButtons.h"

#include <gtest/gtest.h>
#include <wx/filefn.h>
#include <wx/utils.h>

#include <windows.h>

// The toolkit's names back from the system's macros (FindWindow).
#include <wx/msw/winundef.h>

#include <algorithm>
#include <fstream>
#include <map>
#include <tuple>

namespace {

const std::vector<std::string> kModules = {
    "Quenta Print Studio.exe", "Monitor\\Zel Display Studio.exe", "Quenta Link Studio.exe",
    "ZelVerifyStudio.exe",     "Quenta Inspect Studio.exe",       "Quenta Edit Studio.exe"};

class ModuleStartTest : public testing::Test
{
protected:
    void SetUp() override
    {
        wxSetWorkingDirectory(m_install.Path());
        m_frame = new Veltro3AppFrame("Veltrona", wxPoint(50, 50), wxDefaultSize);
    }
    void TearDown() override { m_frame->Destroy(); }

    StandinDir m_install{kModules};
    const std::string m_log = m_install.Path() + "\\starts.log";
    ScopedEnv m_env{{{"VELTRONA_STANDIN_LOG", m_log}, {"VELTRONA_STANDIN_EXIT", "1"}}};
    Veltro3AppFrame* m_frame = nullptr;
};

TEST_F(ModuleStartTest, ClicksKeysAndCommandsStartEachModuleWithItsCommandLine)
{
    DialogRecorder dialogs;
    m_frame->Show();
    const std::vector<std::string> verify = {"VLT", std::to_string(GetModuleLanguageId())};
    enum How
    {
        Click,
        Space,
        Command
    };
    const struct
    {
        int id;
        How how;
        const char* exe;
        std::vector<std::string> args;
    } cases[] = {
        {1101, Click, "Quenta Print Studio.exe", {}},
        {1100, Space, "Monitor\\Zel Display Studio.exe", {}},
        {1003, Command, "Quenta Link Studio.exe", {}},
        {1105, Click, "ZelVerifyStudio.exe", verify},
        {1004, Command, "ZelVerifyStudio.exe", verify},
        {1104, Space, "Quenta Inspect Studio.exe", {}},
        {1006, Command, "Quenta Edit Studio.exe", {}},
    };
    size_t started = 0;
    for (const auto& test : cases) {
        SCOPED_TRACE(test.id);
        if (test.how == Command) {
            m_frame->ProcessCommand(test.id);
        } else {
            wxWindow* button = m_frame->GetStandardView()->FindWindow(test.id);
            ASSERT_TRUE(button && button->IsShownOnScreen());
            const HWND window = button->GetHWND();
            if (test.how == Click) {
                // The button asks the system where the pointer is: it goes there first.
                const wxPoint centre = button->GetScreenRect().GetPosition() + wxPoint(20, 20);
                SetCursorPos(centre.x, centre.y);
                PostMessageW(window, WM_LBUTTONDOWN, MK_LBUTTON, MAKELPARAM(20, 20));
                PostMessageW(window, WM_LBUTTONUP, 0, MAKELPARAM(20, 20));
            } else {
                button->SetFocus();
                PostMessageW(window, WM_KEYDOWN, VK_SPACE, 0x00390001);
                PostMessageW(window, WM_KEYUP, VK_SPACE, 0xC0390001);
            }
        }
        const auto records = WaitForRecords(m_log, ++started);
        ASSERT_EQ(records.size(), started);
        // The whole path as argv[0]: the command line quoted it, blanks and all.
        EXPECT_EQ(std::tie(records.back().exe, records.back().args, records.back().cwd),
                  std::make_tuple(m_install.Path() + "\\" + test.exe, test.args, m_install.Path()));
    }
    // A dropped file with blanks reaches Inspect as one argument.
    const wxString dropped = m_install.Path() + "\\my profiles\\screen one.icc";
    EXPECT_TRUE(DragNDrop(m_frame->GetStandardView(), 1005).OnDropFiles(0, 0, {1, &dropped}));
    const auto records = SettledRecords(m_log);
    ASSERT_EQ(records.size(), started + 1);
    EXPECT_EQ(records.back().args, std::vector<std::string>{dropped.utf8_string()});
    EXPECT_TRUE(dialogs.Dialogs().empty());
}

// A running Verify (class "TFrm_Main", title "Zel Verify Studio"), minimised, is restored
// instead of started again; without the Verify executable nothing happens at all.
TEST_F(ModuleStartTest, RunningVerifyIsRestoredInsteadOfStarted)
{
    StandinDir other({"ZelVerifyStudio.exe"});
    const std::string ready = other.Path() + "\\ready";
    long pid = 0;
    {
        ScopedEnv env({{"VELTRONA_STANDIN_LOG", ready + ".log"},
                       {"VELTRONA_STANDIN_EXIT", "0"},
                       {"VELTRONA_STANDIN_READY", ready}});
        pid = wxExecute("\"" + other.Path() + "\\ZelVerifyStudio.exe\"", wxEXEC_ASYNC);
    }
    ASSERT_TRUE(pid > 0 && WaitFor([&] { return wxFileExists(ready); }, 30000));
    unsigned long long handle = 0;
    std::ifstream(ready) >> handle;
    const HWND verify = reinterpret_cast<HWND>(handle);
    ASSERT_EQ(FindWindowW(L"TFrm_Main", L"Zel Verify Studio"), verify);

    m_frame->Show();
    for (const bool installed : {true, false}) {
        SCOPED_TRACE(installed);
        if (!installed)
            wxRemoveFile(m_install.Path() + "\\ZelVerifyStudio.exe");
        ShowWindow(verify, SW_MINIMIZE);
        ASSERT_TRUE(WaitFor([&] { return IsIconic(verify); }));
        m_frame->ProcessCommand(1004);
        EXPECT_EQ(WaitFor([&] { return !IsIconic(verify); }, 3000), installed);
        EXPECT_TRUE(SettledRecords(m_log, pid).empty());
    }
    wxKill(pid, wxSIGKILL);
}

// The launcher in another process, as a screen reader sees it: each module button and
// Help a push button named by its translated label, "click" its default action, which
// starts the module.
TEST(ScreenReaderTest, ButtonsAnswerThroughMsaaAndTheirActionStartsTheModule)
{
    CoInitializeEx(nullptr, COINIT_APARTMENTTHREADED);
    StandinDir install(kModules);
    const std::string log = install.Path() + "\\starts.log";
    const std::map<std::string, std::string> exes = {
        {"Printer", kModules[0]}, {"Monitor", kModules[1]}, {"Device Link", kModules[2]},
        {"Verify", kModules[3]},  {"Inspect", kModules[4]}, {"Edit", kModules[5]}};
    // The user's language, as Windows says it (Wine: that of the prefix), not LANG.
    const std::vector<std::string> names = {"Device Link", "Edit",    "Help",  "Inspect",
                                            "Monitor",     "Printer", "Verify"};
    size_t started = 0;
    { // The launcher ends before the starts are counted.
        ProbeRun run(install.Path(), {},
                     {{"VELTRONA_STANDIN_LOG", log}, {"VELTRONA_STANDIN_EXIT", "1"}});
        ASSERT_TRUE(run.WaitForShown(60000)) << "the launcher's frame";
        const HWND frame = reinterpret_cast<HWND>(uintptr_t(run.Window()));
        ASSERT_TRUE(frame) << "the launcher's window";
        std::vector<ReaderButton> buttons;
        EXPECT_TRUE(WaitFor([&] {
            for (const ReaderButton& button : buttons)
                button.accessible->Release();
            buttons = ReaderButtons(frame);
            return buttons.size() == names.size();
        })) << "the launcher's buttons through MSAA";
        std::vector<std::string> found;
        for (const ReaderButton& button : buttons) {
            found.push_back(button.name);
            EXPECT_EQ(button.defaultAction, "click") << button.name;
        }
        std::sort(found.begin(), found.end());
        EXPECT_EQ(found, names);

        // Every module button's action starts its module.
        for (const ReaderButton& button : buttons) {
            const auto exe = exes.find(button.name);
            if (exe != exes.end()) {
                VARIANT self;
                self.vt = VT_I4;
                self.lVal = CHILDID_SELF;
                EXPECT_EQ(button.accessible->accDoDefaultAction(self), S_OK) << button.name;
                const auto records = WaitForRecords(log, ++started);
                ASSERT_EQ(records.size(), started) << button.name;
                EXPECT_EQ(records.back().exe, install.Path() + "\\" + exe->second);
            }
            button.accessible->Release();
        }
    }
    EXPECT_EQ(SettledRecords(log).size(), started);
    CoUninitialize();
}

} // namespace
