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
#include <wx/filename.h>
#include <wx/stattext.h>
#include <wx/stdpaths.h>
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
    const std::pair<const char*, const char*> cases[] = {
        {"de_DE", "de"}, {"de", "de"},    {"de_AT", "en"}, {"de_CH", "en"}, {"fr_CA", "en"},
        {"fr", "fr"},    {"it_IT", "it"}, {"ja", "ja"},    {"pt_BR", "pt"}, {"pt_PT", "en"},
        {"pt", "en"},    {"nl_BE", "en"}, {"es_ES", "es"}, {"en_GB", "en"}, {"", "en"},
    };
    for (const auto& [name, folder] : cases)
        EXPECT_EQ(HelpFolderLanguage(name), folder) << name;
}

TEST(HelpToolTest, PageNamesAndPathsOfEachProgram)
{
    struct Case
    {
        const char* appName;
        const char* page;
        const char* shownPage;
        const char* below; // the path below Documentation/<language>/Help/, null for none
    };
    const Case cases[] = {
        {"Veltrona", "Launcher", "Launcher.html", "Launcher.html"},
        {"Veltrona", "Notes.html.old", "Notes.html.old", "Notes.html.old"},
        {"Quenta Link Studio", "Start", "Start.html", "LinkStudio/Start.html"},
        {"Quenta Inspect Studio", "a.html", "a.html", "InspectStudio/a.html"},
        {"Veltrona Updater", "Update", "Update.html", "Update.html"},
        {"veltrona", "Launcher", "Launcher.html", nullptr},
    };
    const wxString installDir = wxFileName(wxStandardPaths::Get().GetExecutablePath())
                                    .GetPath(wxPATH_GET_VOLUME | wxPATH_GET_SEPARATOR);
    for (const Case& c : cases) {
        SCOPED_TRACE(c.appName + std::string(" ") + c.page);
        CHelpToolDlg* dialog = NewDialog(c.appName, c.page);
        const wxString expected =
            c.below ? installDir + "Documentation/" + dialog->GetHelpLanguage() + "/Help/" + c.below
                    : installDir;
        EXPECT_EQ(dialog->m_preferredField->GetValue(), c.shownPage);
        EXPECT_EQ(dialog->m_alternateField->GetValue(), "AlternateHelp.html");
        EXPECT_EQ(dialog->m_pathField->GetValue(), expected);
        EXPECT_EQ(dialog->m_preferredStatus->GetLabel(), "Not Found!");
        dialog->Destroy();
    }
}

TEST(HelpToolTest, KeysInAFieldCopyThePathAndCloseTheDialog)
{
    struct Key
    {
        int code;
        bool control;
    };
    struct Case
    {
        const char* what;
        std::vector<Key> keys;
        int result;
        bool pathCopied;
    };
    const Case cases[] = {
        {"Ctrl+A, Ctrl+C, Escape",
         {{'A', true}, {'C', true}, {WXK_ESCAPE, false}},
         wxID_CANCEL,
         true},
        {"Enter", {{WXK_RETURN, false}}, wxID_OK, false},
        {"keypad Enter with Ctrl", {{WXK_NUMPAD_ENTER, true}}, wxID_OK, false},
        {"a letter, then Escape", {{'x', false}, {WXK_ESCAPE, false}}, wxID_CANCEL, false},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.what);
        if (wxTheClipboard->Open()) {
            wxTheClipboard->SetData(new wxTextDataObject("before"));
            wxTheClipboard->Close();
        }
        CHelpToolDlg* dialog = NewDialog("Veltrona", "Launcher");
        const wxString path = dialog->m_pathField->GetValue();
        dialog->CallAfter([dialog, &c] {
            for (const Key& key : c.keys) {
                wxKeyEvent event(wxEVT_KEY_DOWN);
                event.m_keyCode = key.code;
                event.m_controlDown = key.control;
                event.SetEventObject(dialog->m_pathField);
                dialog->m_pathField->ProcessWindowEvent(event);
            }
        });
        // A dialog the keys did not close ends here instead of hanging the test.
        wxTimer guard;
        guard.Bind(wxEVT_TIMER, [dialog](wxTimerEvent&) { dialog->EndModal(-1); });
        guard.StartOnce(5000);
        EXPECT_EQ(dialog->ShowModal(), c.result);
        EXPECT_EQ(dialog->m_pathField->GetValue(), path);
        dialog->Destroy();

        wxTextDataObject copied;
        ASSERT_TRUE(wxTheClipboard->Open());
        wxTheClipboard->GetData(copied);
        wxTheClipboard->Close();
        EXPECT_EQ(copied.GetText(), c.pathCopied ? path : "before");
    }
}

TEST(HelpToolTest, StatusesFollowThePagesOfTheUsersLanguage)
{
    struct Case
    {
        const char* lang;
        std::vector<std::string> pages; // below Documentation/
        const char* folder;
        const char* preferred;
        const char* alternate;
    };
    const Case cases[] = {
        {"de_DE.UTF-8",
         {"de/Help/Launcher.html", "de/Help/AlternateHelp.html"},
         "de",
         "Found!",
         "Found!"},
        {"de_AT.UTF-8",
         {"de/Help/Launcher.html", "de/Help/AlternateHelp.html"},
         "en",
         "Not Found!",
         "Not Found!"},
        {"fr_CA.UTF-8",
         {"en/Help/AlternateHelp.html", "fr/Help/Launcher.html"},
         "en",
         "Not Found!",
         "Found!"},
        {"it_IT.UTF-8", {"it/Help/Launcher.html"}, "it", "Found!", "Not Found!"},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.lang);
        StandinDir install({});
        for (const std::string& page : c.pages) {
            const fs::path file = fs::path(install.Path()) / "Documentation" / page;
            fs::create_directories(file.parent_path());
            std::ofstream(file) << "<p>help</p>";
        }
        fs::create_hard_link(VELTRONA_PROBE_PATH, install.Path() + "/Veltrona.exe");
        StandinDir runtime({});
        ProbeRun launcher(install.Path(), {},
                          {{"LANG", c.lang},
                           {"LC_ALL", ""},
                           {"LC_MESSAGES", ""},
                           {"XDG_RUNTIME_DIR", runtime.Path()},
                           {"VELTRONA_PROBE_COMMAND", "1018"}});
        ASSERT_TRUE(WaitFor([&] { return launcher.Events("command").size() == 2; }, 30000));
        const auto dialogs = launcher.Events("dialog");
        ASSERT_EQ(dialogs.size(), 1u);
        ASSERT_EQ(dialogs[0].fields.size(), 4u);
        EXPECT_EQ(dialogs[0].fields[1], "Quenta Contextual Help Tool");
        const std::string path =
            install.Path() + "/Documentation/" + c.folder + "/Help/Launcher.html";
        EXPECT_EQ(dialogs[0].fields[3], std::string("Help file information\nPreferred:\n"
                                                    "Launcher.html\n") +
                                            c.preferred + "\nAlternate:\nAlternateHelp.html\n" +
                                            c.alternate + "\n       Path:\n" + path + "\n&OK\n");
    }
}

} // namespace
