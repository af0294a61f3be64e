// The launcher's help as a user meets it: the help command, with the viewer installed
// or missing (one that never answers: RaiseServiceTest), and the help tool dialog.
#include "help/CHelpToolDlg.h"
#include "help/HelpToolTextCtrl.h"

#include "support/ClipboardManager.h"
#include "support/DesktopTools.h"
#include "support/GuiWait.h"
#include "support/ProbeRun.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gtest/gtest.h>
#include <wx/clipbrd.h>
#include <wx/timer.h>

#include <csignal>
#include <filesystem>
#include <memory>

namespace {

namespace fs = std::filesystem;

TEST(ContextualHelpTest, HelpCommandShowsTheLauncherPageInTheViewer)
{
    for (const std::string viewer : {VELTRONA_HELPVIEWER_PATH, ""}) {
        SCOPED_TRACE(viewer);
        StandinDir install({});
        const std::string page = install.Write("Documentation/en/Help/Launcher.html", "<p>L</p>");
        if (!viewer.empty()) {
            fs::create_directories(install.Path() + "/Help");
            fs::create_symlink(viewer, install.Path() + "/Help/Veltrona Help.exe");
        }
        const std::string starts = install.Path() + "/starts.log",
                          log = install.Path() + "/viewer.log";
        ProbeRun launcher(install.Path(), {},
                          {{"VELTRONA_STANDIN_LOG", starts},
                           {"VELTRONA_HELP_LOG", log},
                           {"VELTRONA_PROBE_COMMAND", "1015"}});
        ASSERT_TRUE(WaitFor([&] { return launcher.Events("command").size() == 2; }, 30000));
        const auto viewers = viewer.empty() ? ReadRecords(starts) : WaitForRecords(starts, 1);
        std::shared_ptr<void> stop(nullptr, [viewers](void*) {
            for (const StandinRecord& viewer : viewers)
                kill(viewer.pid, SIGKILL);
        });
        ASSERT_EQ(viewers.size(), viewer.empty() ? 0u : 1u);
        if (viewer.empty())
            continue;
        EXPECT_EQ(viewers[0].exe, install.Path() + "/Help/Veltrona Help.exe");
        EXPECT_EQ(viewers[0].cwd, install.Path());
        ASSERT_TRUE(WaitFor([&] { return ReadEventLog(log).size() >= 2; }));
        const auto events = ReadEventLog(log);
        EXPECT_EQ(events[0].fields,
                  (std::vector<std::string>{"Application", "LaunchPad$Launcher.html"}));
        EXPECT_EQ(events[1].fields, std::vector<std::string>{page});
    }
}

// Ctrl+A and Ctrl+C copy the path; Return and Escape end the dialog. A page named
// with its extension keeps it.
TEST(HelpToolTest, KeysCopyThePathAndEndTheDialog)
{
    for (const int end : {WXK_RETURN, WXK_ESCAPE}) {
        auto* dialog =
            new CHelpToolDlg("Veltrona", end == WXK_RETURN ? "a" : "b.html", nullptr, wxID_ANY,
                             "Help", wxDefaultPosition, wxDefaultSize, wxDEFAULT_DIALOG_STYLE);
        HelpToolTextCtrl* field = dialog->m_pathField;
        EXPECT_EQ(dialog->m_preferredField->GetValue(), end == WXK_RETURN ? "a.html" : "b.html");
        dialog->CallAfter([field, end] {
            for (const int code : {int('A'), int('C'), end}) {
                wxKeyEvent event(wxEVT_KEY_DOWN);
                event.m_keyCode = code;
                event.m_controlDown = code != end;
                field->ProcessWindowEvent(event);
            }
        });
        wxTimer guard;
        guard.Bind(wxEVT_TIMER, [dialog](wxTimerEvent&) { dialog->EndModal(-1); });
        guard.StartOnce(5000);
        EXPECT_EQ(dialog->ShowModal(), end == WXK_RETURN ? wxID_OK : wxID_CANCEL);
        wxTextDataObject copied;
        ASSERT_TRUE(wxTheClipboard->Open());
        wxTheClipboard->GetData(copied);
        wxTheClipboard->Clear();
        wxTheClipboard->Close();
        EXPECT_EQ(copied.GetText(), field->GetValue());
        dialog->Destroy();
    }
}

// The path copied with the keys in the shown help tool outlives the launcher: at its
// end the desktop's clipboard manager takes it over.
TEST(HelpToolTest, CopiedPathOutlivesTheLauncher)
{
    ClipboardManager manager;
    ASSERT_TRUE(manager.Running());
    StandinDir install({});
    ProbeRun launcher(install.Path(), {},
                      {{"LANG", "en_US.UTF-8"},
                       {"LC_ALL", ""},
                       {"VELTRONA_PROBE_SHOW_DIALOGS", "1"},
                       {"VELTRONA_PROBE_COMMAND", "1018"}});
    unsigned long tool = 0;
    ASSERT_TRUE(WaitFor(
        [&] { return (tool = WindowOf(launcher.Pid(), "Quenta Contextual Help Tool")) != 0; },
        30000))
        << "the help tool's window";
    // OK has the focus; the path field is just before it.
    TypeKeys(tool, "shift+Tab ctrl+a ctrl+c Escape");
    ASSERT_TRUE(WaitFor([&] { return launcher.Events("command").size() == 2; }))
        << "the help tool's end";
    CloseWindow(launcher.Window());
    ASSERT_EQ(launcher.ExitCode(), 0);
    EXPECT_EQ(ClipboardText(), install.Path() + "/Documentation/en/Help/Launcher.html");
}

TEST(HelpToolTest, StatusesFollowThePagesOfTheUsersLanguage)
{
    const struct
    {
        // The folders holding the two pages ("": none), the folder shown and the statuses.
        const char *lang, *launcherIn, *alternateIn, *folder, *preferred, *alternate;
    } cases[] = {
        {"de_DE", "de", "de", "de", "Found!", "Found!"},
        {"de_AT", "de", "de", "en", "Not Found!", "Not Found!"},
        {"fr_CA", "", "en", "en", "Not Found!", "Found!"},
        {"pt_BR", "pt", "", "pt", "Found!", "Not Found!"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.lang);
        StandinDir install({});
        for (const auto& [folder, page] :
             {std::pair{c.launcherIn, "Launcher.html"}, {c.alternateIn, "AlternateHelp.html"}})
            if (*folder)
                install.Write("Documentation/" + std::string(folder) + "/Help/" + page, "<p>h</p>");
        ProbeRun launcher(install.Path(), {},
                          {{"LANG", c.lang + std::string(".UTF-8")},
                           {"LC_ALL", ""},
                           {"LC_MESSAGES", ""},
                           {"VELTRONA_PROBE_COMMAND", "1018"}});
        ASSERT_TRUE(WaitFor([&] { return launcher.Events("command").size() == 2; }, 30000));
        const auto dialogs = launcher.Events("dialog");
        ASSERT_EQ(dialogs.size(), 1u);
        EXPECT_EQ(dialogs[0].fields.at(3),
                  std::string("Help file information\nPreferred:\nLauncher.html\n") + c.preferred +
                      "\nAlternate:\nAlternateHelp.html\n" + c.alternate + "\n       Path:\n" +
                      install.Path() + "/Documentation/" + c.folder + "/Help/Launcher.html\n&OK\n");
    }
}

} // namespace
