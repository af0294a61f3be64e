// The help tool dialog: the page and path it shows, its fields' keys, and its
// statuses for the user's real locale.
#include "help/CHelpToolDlg.h"
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

wxString Clipboard(const wxString& text = "")
{
    EXPECT_TRUE(wxTheClipboard->Open());
    wxTextDataObject data(text);
    text.empty() ? wxTheClipboard->GetData(data)
                 : wxTheClipboard->SetData(new wxTextDataObject(text));
    wxTheClipboard->Close();
    return data.GetText();
}

// Ctrl+A and Ctrl+C copy the path; Return and Escape end the dialog.
TEST(HelpToolTest, PageNamesAndKeysThatCopyThePathAndCloseTheDialog)
{
    const struct
    {
        const char *page, *shownPage;
        std::vector<int> keys; // letters with Ctrl held
        int result;
    } cases[] = {{"Launcher", "Launcher.html", {'A', 'C', WXK_RETURN}, wxID_OK},
                 {"b.html", "b.html", {'C', WXK_ESCAPE}, wxID_CANCEL}};
    for (const auto& c : cases) {
        SCOPED_TRACE(c.page);
        Clipboard("before");
        auto* dialog = new CHelpToolDlg("Veltrona", c.page, nullptr, wxID_ANY, "Help",
                                        wxDefaultPosition, wxDefaultSize, wxDEFAULT_DIALOG_STYLE);
        HelpToolTextCtrl* field = dialog->m_pathField;
        EXPECT_EQ(dialog->m_preferredField->GetValue(), c.shownPage);
        EXPECT_TRUE(field->GetValue().EndsWith(wxString("/Help/") + c.shownPage));
        dialog->CallAfter([field, &c] {
            for (int code : c.keys) {
                wxKeyEvent event(wxEVT_KEY_DOWN);
                event.m_keyCode = code;
                event.m_controlDown = code >= 'A';
                field->ProcessWindowEvent(event);
            }
        });
        wxTimer guard;
        guard.Bind(wxEVT_TIMER, [dialog](wxTimerEvent&) { dialog->EndModal(-1); });
        guard.StartOnce(5000);
        EXPECT_EQ(dialog->ShowModal(), c.result);
        EXPECT_EQ(Clipboard(), c.result == wxID_OK ? field->GetValue() : "before");
        dialog->Destroy();
    }
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
        StandinDir install({}), runtime({});
        for (const auto& [folder, page] :
             {std::pair{c.launcherIn, "Launcher.html"}, {c.alternateIn, "AlternateHelp.html"}}) {
            if (!*folder)
                continue;
            const fs::path file =
                fs::path(install.Path()) / "Documentation" / folder / "Help" / page;
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
        EXPECT_EQ(dialogs[0].fields.at(3),
                  std::string("Help file information\nPreferred:\nLauncher.html\n") + c.preferred +
                      "\nAlternate:\nAlternateHelp.html\n" + c.alternate + "\n       Path:\n" +
                      install.Path() + "/Documentation/" + c.folder + "/Help/Launcher.html\n&OK\n");
    }
}

} // namespace
