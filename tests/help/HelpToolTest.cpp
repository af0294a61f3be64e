// The help tool dialog: the page and path it shows for each program, its
// statuses for the user's real locale, and its fields' keys.
#include "help/CHelpToolDlg.h"
#include "help/HelpLanguage.h"
#include "help/HelpToolTextCtrl.h"

#include "support/GuiWait.h"
#include "support/ProbeRun.h"
#include "support/StandinDir.h"

#include <gtest/gtest.h>
#include <wx/clipbrd.h>
#include <wx/timer.h>

#include <filesystem>
#include <fstream>

namespace {

namespace fs = std::filesystem;

CHelpToolDlg* NewDialog(const wxString& appName, const wxString& page)
{
    return new CHelpToolDlg(appName, page, nullptr, wxID_ANY, "Quenta Contextual Help Tool",
                            wxDefaultPosition, wxSize(625, 200), wxDEFAULT_DIALOG_STYLE);
}

TEST(HelpToolTest, HelpFolderOnlyForTheExactLanguagesOfTheHelp)
{
    for (const auto& [name, folder] : {std::pair{"de", "de"},
                                       {"de_CH", "en"},
                                       {"ja", "ja"},
                                       {"pt_BR", "pt"},
                                       {"pt", "en"},
                                       {"nl_BE", "en"},
                                       {"", "en"}})
        EXPECT_EQ(HelpFolderLanguage(name), folder) << name;
}

TEST(HelpToolTest, PageNamesAndKeysThatCopyThePathAndCloseTheDialog)
{
    const struct
    {
        const char *page, *shownPage;
        std::vector<std::pair<int, bool>> keys; // key code, Ctrl held
        int result;
        bool pathCopied;
    } cases[] = {
        {"Launcher",
         "Launcher.html",
         {{'A', true}, {'C', true}, {WXK_ESCAPE, false}},
         wxID_CANCEL,
         true},
        {"a.html.old", "a.html.old", {{'C', true}, {WXK_RETURN, false}}, wxID_OK, false},
        {"b.html", "b.html", {{WXK_NUMPAD_ENTER, true}}, wxID_OK, false},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(testing::Message() << &c - cases);
        ASSERT_TRUE(wxTheClipboard->Open());
        wxTheClipboard->SetData(new wxTextDataObject("before"));
        wxTheClipboard->Close();
        CHelpToolDlg* dialog = NewDialog("Veltrona", c.page);
        HelpToolTextCtrl* field = dialog->m_pathField;
        EXPECT_EQ(dialog->m_preferredField->GetValue(), c.shownPage);
        EXPECT_TRUE(field->GetValue().EndsWith(wxString("/Help/") + c.shownPage));
        dialog->CallAfter([field, &c] {
            for (const auto& [code, control] : c.keys) {
                wxKeyEvent event(wxEVT_KEY_DOWN);
                event.m_keyCode = code;
                event.m_controlDown = control;
                field->ProcessWindowEvent(event);
            }
        });
        // A dialog that the keys left open ends here instead of hanging the test.
        wxTimer guard;
        guard.Bind(wxEVT_TIMER, [dialog](wxTimerEvent&) { dialog->EndModal(-1); });
        guard.StartOnce(5000);
        EXPECT_EQ(dialog->ShowModal(), c.result);
        wxTextDataObject copied;
        ASSERT_TRUE(wxTheClipboard->Open());
        wxTheClipboard->GetData(copied);
        wxTheClipboard->Close();
        EXPECT_EQ(copied.GetText(), c.pathCopied ? field->GetValue() : "before");
        dialog->Destroy();
    }
}

TEST(HelpToolTest, StatusesFollowThePagesOfTheUsersLanguage)
{
    const struct
    {
        const char* lang;
        std::vector<std::string> pages; // below Documentation/
        const char *folder, *preferred, *alternate;
    } cases[] = {
        {"de_DE",
         {"de/Help/Launcher.html", "de/Help/AlternateHelp.html"},
         "de",
         "Found!",
         "Found!"},
        {"de_AT",
         {"de/Help/Launcher.html", "de/Help/AlternateHelp.html"},
         "en",
         "Not Found!",
         "Not Found!"},
        {"fr_CA", {"en/Help/AlternateHelp.html"}, "en", "Not Found!", "Found!"},
        {"it_IT", {"it/Help/Launcher.html"}, "it", "Found!", "Not Found!"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.lang);
        StandinDir install({}), runtime({});
        for (const std::string& page : c.pages) {
            const fs::path file = fs::path(install.Path()) / "Documentation" / page;
            fs::create_directories(file.parent_path());
            std::ofstream(file) << "<p>help</p>";
        }
        fs::create_hard_link(VELTRONA_PROBE_PATH, install.Path() + "/Veltrona.exe");
        ProbeRun launcher(install.Path(), {},
                          {{"LANG", c.lang + std::string(".UTF-8")},
                           {"LC_ALL", ""},
                           {"LC_MESSAGES", ""},
                           {"XDG_RUNTIME_DIR", runtime.Path()},
                           {"VELTRONA_PROBE_COMMAND", "1018"}});
        ASSERT_TRUE(WaitFor([&] { return launcher.Events("command").size() == 2; }, 30000));
        const auto dialogs = launcher.Events("dialog");
        ASSERT_EQ(dialogs.size(), 1u);
        EXPECT_EQ(dialogs[0].fields[1], "Quenta Contextual Help Tool");
        EXPECT_EQ(dialogs[0].fields.at(3),
                  std::string("Help file information\nPreferred:\nLauncher.html\n") + c.preferred +
                      "\nAlternate:\nAlternateHelp.html\n" + c.alternate + "\n       Path:\n" +
                      install.Path() + "/Documentation/" + c.folder + "/Help/Launcher.html\n&OK\n");
    }
}

} // namespace
