// The user guide and the web pages, opened through a test desktop of their
// own: XDG folders in which a stand-in PDF reader is registered (or not), and
// a stand-in browser opener on PATH.
#include "controls/ZelLinkText.h"
#include "help/CAcrobatNotFoundDialog.h"
#include "help/Documentation.h"
#include "support/DialogRecorder.h"
#include "support/GuiWait.h"
#include "support/ScopedEnv.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gdk/gdk.h>
#include <gtest/gtest.h>
#include <wx/app.h>
#include <wx/timer.h>
#include <wx/uiaction.h>

#include <filesystem>
#include <fstream>

namespace fs = std::filesystem;

namespace {

const std::string kXdgOpen = "/usr/bin/xdg-open";

// The real opener needs the system's tools; stand-ins must not fall back on it.
std::string SystemPath(const std::string& opener)
{
    return opener == kXdgOpen ? ":/usr/bin:/bin" : "";
}

// A desktop with its own XDG folders and PATH; the stand-ins record into Log().
class TestDesktop
{
public:
    explicit TestDesktop(const std::string& opener = kXdgOpen)
        : m_dir({"pdfreader"}), m_env({{"XDG_DATA_HOME", Root() + "/data"},
                                       {"XDG_DATA_DIRS", Root() + "/share"},
                                       {"XDG_CONFIG_HOME", Root() + "/config"},
                                       {"XDG_CONFIG_DIRS", Root() + "/none"},
                                       {"XDG_CURRENT_DESKTOP", std::nullopt},
                                       {"DESKTOP_SESSION", std::nullopt},
                                       {"PATH", Root() + "/bin" + SystemPath(opener)},
                                       {"VELTRONA_STANDIN_LOG", Log()},
                                       {"VELTRONA_STANDIN_EXIT", "1"}})
    {
        fs::create_directories(Root() + "/data/applications");
        // The system's MIME database and icons without the system's programs.
        fs::create_directories(Root() + "/share");
        fs::create_symlink("/usr/share/mime", Root() + "/share/mime");
        fs::create_symlink("/usr/share/icons", Root() + "/share/icons");
        fs::create_directories(Root() + "/bin");
        fs::create_symlink(opener, Root() + "/bin/xdg-open");
    }

    const std::string& Root() const { return m_dir.Path(); }
    std::string Log() const { return Root() + "/starts.log"; }

    void InstallReader() const
    {
        std::ofstream(Root() + "/data/applications/pdfreader.desktop")
            << "[Desktop Entry]\nType=Application\nName=Reader\nExec=" << Root()
            << "/pdfreader %f\nMimeType=application/pdf;\n";
        std::ofstream(Root() + "/data/applications/mimeapps.list")
            << "[Default Applications]\napplication/pdf=pdfreader.desktop\n";
    }

private:
    StandinDir m_dir;
    ScopedEnv m_env;
};

TEST(UserGuideTest, GuideOfTheLanguageFolderOpensInTheReader)
{
    TestDesktop desktop;
    desktop.InstallReader();
    const std::string install = desktop.Root() + "/it's \"my\" install/";
    const std::string guides = install + "Help/Documentation/";
    for (const char* folder : {"en", "de", "zh_CN"})
        std::ofstream((fs::create_directories(guides + folder), guides + folder + "/Veltrona.pdf"))
            << "%PDF-1.4\n";
    fs::create_directories(guides + "fr");

    const struct
    {
        const char* language;
        const char* folder;
        bool found;
    } cases[] = {{"de_DE", "de", true},
                 {"it_IT", "en", true},
                 {"", "en", true},
                 {"zh_CN", "zh_CN", true},
                 {"fr_FR", "fr", false}};
    for (const auto& test : cases) {
        SCOPED_TRACE(test.language);
        fs::remove(desktop.Log());
        DialogRecorder dialogs;
        OpenUserGuide(install, test.language);
        const auto records = SettledRecords(desktop.Log());
        const std::string path = guides + test.folder + "/Veltrona.pdf";
        if (test.found) {
            ASSERT_EQ(records.size(), 1u);
            EXPECT_EQ(records[0].args, std::vector<std::string>{path});
            EXPECT_TRUE(dialogs.Dialogs().empty());
        } else {
            EXPECT_TRUE(records.empty());
            ASSERT_EQ(dialogs.Dialogs().size(), 1u);
            EXPECT_EQ(dialogs.Dialogs()[0].message, "\"" + path + "\" not found.");
            EXPECT_EQ(dialogs.Dialogs()[0].caption, "Message");
        }
    }
}

TEST(UserGuideTest, WithoutAReaderTheDialogAsksAgainOnlyAfterOK)
{
    const struct
    {
        const char* name;
        int answer;
        bool installMeanwhile;
        bool opened;
    } cases[] = {{"OK after installing", wxID_OK, true, true},
                 {"Escape after installing", wxID_CANCEL, true, false},
                 {"OK, still none", wxID_OK, false, false}};
    for (const auto& test : cases) {
        SCOPED_TRACE(test.name);
        TestDesktop desktop;
        EXPECT_FALSE(PdfReaderInstalled());
        DialogRecorder dialogs([&](wxDialog*) {
            if (test.installMeanwhile)
                desktop.InstallReader();
            return test.answer;
        });
        OpenUserGuide();
        // This program's folder has no guide: a second question that finds
        // the reader ends in the "not found." message.
        ASSERT_EQ(dialogs.Dialogs().size(), test.opened ? 2u : 1u);
        EXPECT_EQ(dialogs.Dialogs()[0].caption, "Acrobat Reader not found");
        if (test.opened) {
            EXPECT_TRUE(dialogs.Dialogs()[1].message.EndsWith(
                "/Help/Documentation/en/Veltrona.pdf\" not found."));
        }
    }
}

TEST(UserGuideTest, EscapeClosesTheReaderDialogWithoutOK)
{
    CAcrobatNotFoundDialog dialog(nullptr);
    wxTimer giveUp;
    giveUp.Bind(wxEVT_TIMER, [&](wxTimerEvent&) { dialog.EndModal(wxID_ABORT); });
    giveUp.StartOnce(10000);
    wxTheApp->CallAfter([&] {
        WaitFor([&] { return dialog.IsActive(); }, 5000);
        wxUIActionSimulator().Char(WXK_ESCAPE);
    });
    EXPECT_EQ(dialog.ShowModal(), wxID_CANCEL);
}

GdkCursorType CursorType(const wxWindow* window)
{
    GdkCursor* cursor = window->GetCursor().GetCursor();
    return cursor ? gdk_cursor_get_cursor_type(cursor) : GDK_CURSOR_IS_PIXMAP;
}

TEST(UserGuideTest, ReaderLinkLightsUpUnderThePointerAndOpensItsAddress)
{
    TestDesktop desktop(VELTRONA_STANDIN_PATH);
    auto* dialog = new CAcrobatNotFoundDialog(nullptr);
    dialog->Show();
    ZelLinkText* link = dialog->m_link;
    ASSERT_TRUE(WaitFor([&] { return link->IsShownOnScreen(); }));
    EXPECT_EQ(link->GetURL(), kReaderDownloadPage);
    EXPECT_EQ(link->GetForegroundColour(), *wxBLUE);
    EXPECT_TRUE(link->GetFont().GetUnderlined());
    const wxCursor before(wxCURSOR_CROSS);
    link->SetCursor(before);

    wxUIActionSimulator pointer;
    const wxRect area = link->GetScreenRect();
    pointer.MouseMove(area.GetLeft() + 4, area.GetTop() + area.GetHeight() / 2);
    EXPECT_TRUE(WaitFor([&] { return link->GetForegroundColour() == *wxRED; }));
    EXPECT_EQ(CursorType(link), GDK_HAND2);
    pointer.MouseMove(area.GetRight() + 40, area.GetBottom() + 40);
    EXPECT_TRUE(WaitFor([&] { return link->GetForegroundColour() == *wxBLUE; }));
    EXPECT_TRUE(link->GetCursor().IsSameAs(before));

    pointer.MouseMove(area.GetLeft() + 4, area.GetTop() + area.GetHeight() / 2);
    ASSERT_TRUE(WaitFor([&] { return link->GetForegroundColour() == *wxRED; }));
    wxActivateEvent deactivate(wxEVT_ACTIVATE, false);
    dialog->HandleWindowEvent(deactivate);
    EXPECT_EQ(link->GetForegroundColour(), *wxBLUE);
    EXPECT_TRUE(link->GetCursor().IsSameAs(before));

    pointer.MouseMove(area.GetLeft() + 4, area.GetTop() + area.GetHeight() / 2);
    pointer.MouseClick();
    const auto records = WaitForRecords(desktop.Log(), 1);
    ASSERT_EQ(records.size(), 1u);
    EXPECT_EQ(records[0].args, std::vector<std::string>{kReaderDownloadPage.ToStdString()});
    dialog->Destroy();
}

TEST(UserGuideTest, WebPagesOpenInTheBrowserOrSaySoWhenTheyCannot)
{
    const struct
    {
        const char* name;
        std::string opener;
        void (*command)();
        const char* address;
    } cases[] = {
        {"forum", VELTRONA_STANDIN_PATH, OpenUserForum, "/forumdisplay.php?f=140"},
        {"how-to", VELTRONA_STANDIN_PATH, OpenHowTo, "/Quenta/Products/VLT/How%20To/Guides"},
        {"opener fails", "/bin/false", OpenHowTo, nullptr},
        {"no opener", "/nonexistent/xdg-open", OpenUserForum, nullptr},
    };
    for (const auto& test : cases) {
        SCOPED_TRACE(test.name);
        TestDesktop desktop(test.opener);
        DialogRecorder dialogs;
        test.command();
        if (test.address) {
            const auto records = SettledRecords(desktop.Log());
            ASSERT_EQ(records.size(), 1u);
            ASSERT_EQ(records[0].args.size(), 1u);
            EXPECT_TRUE(wxString(records[0].args[0]).EndsWith(test.address));
            EXPECT_TRUE(records[0].args[0].rfind("https://", 0) == 0);
            EXPECT_TRUE(dialogs.Dialogs().empty());
        } else {
            ASSERT_TRUE(WaitFor([&] { return !dialogs.Dialogs().empty(); }));
            EXPECT_EQ(dialogs.Dialogs()[0].message, "Failed to open the URL");
            EXPECT_EQ(dialogs.Dialogs()[0].caption, "Error");
            EXPECT_EQ(dialogs.Dialogs()[0].style & (wxOK | wxICON_ERROR), wxOK | wxICON_ERROR);
        }
    }
}

} // namespace
