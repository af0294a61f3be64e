// The user guide and the web pages, opened through a test desktop of its own:
// XDG folders in which a stand-in PDF reader is registered (or not), and an
// opener on PATH that is the real xdg-open, a stand-in, or one that fails.
#include "platform/UserLanguage.h"
#include "controls/ZelLinkText.h"
#include "help/CAcrobatNotFoundDialog.h"
#include "help/Documentation.h"
#include "resources/Catalogs.h"
#include "support/DialogRecorder.h"
#include "support/GuiWait.h"
#include "support/ScopedEnv.h"
#include "support/ShownMessageBox.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gtest/gtest.h>
#include <wx/filesys.h>
#include <wx/fs_mem.h>
#include <wx/timer.h>
#include <wx/uiaction.h>

#include <filesystem>
#include <fstream>

namespace fs = std::filesystem;

namespace {

const std::string kXdgOpen = "/usr/bin/xdg-open";

class TestDesktop
{
public:
    explicit TestDesktop(const std::string& opener = kXdgOpen)
        : m_dir({"pdfreader", "bin/xdg-open"}),
          m_env({{"XDG_DATA_HOME", Root() + "/data"},
                 {"XDG_DATA_DIRS", Root() + "/share"},
                 {"XDG_CONFIG_HOME", Root() + "/config"},
                 {"XDG_CONFIG_DIRS", Root() + "/share"},
                 {"XDG_CURRENT_DESKTOP", ""},
                 {"DESKTOP_SESSION", ""},
                 {"PATH", Root() + "/bin" + (opener == kXdgOpen ? ":/usr/bin:/bin" : "")},
                 {"VELTRONA_STANDIN_LOG", Log()},
                 {"VELTRONA_STANDIN_EXIT", "1"}})
    {
        SetOpener(opener);
        // The system's MIME database and icons, without the system's programs.
        fs::create_directories(Root() + "/share");
        fs::create_symlink("/usr/share/mime", Root() + "/share/mime");
        fs::create_symlink("/usr/share/icons", Root() + "/share/icons");
    }

    const std::string& Root() const { return m_dir.Path(); }
    void SetOpener(const std::string& opener) const
    {
        fs::remove(Root() + "/bin/xdg-open");
        fs::create_symlink(opener, Root() + "/bin/xdg-open");
    }
    std::string Log() const { return Root() + "/starts.log"; }

    void InstallReader() const
    {
        m_dir.Write("data/applications/pdfreader.desktop",
                    "[Desktop Entry]\nType=Application\nName=Reader\nExec=" + Root() +
                        "/pdfreader %f\nMimeType=application/pdf;\n");
        m_dir.Write("data/applications/mimeapps.list",
                    "[Default Applications]\napplication/pdf=pdfreader.desktop\n");
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
    for (const char* folder : {"en", "de", "zh_CN", "fr"})
        fs::create_directories(guides + folder);
    for (const char* folder : {"en", "de", "zh_CN"})
        std::ofstream(guides + folder + "/Veltrona.pdf") << "%PDF-1.4\n";

    const struct
    {
        const char *language, *folder;
    } cases[] = {{"de_DE", "de"}, {"it_IT", "en"}, {"zh_CN", "zh_CN"}, {"fr_FR", "fr"}};
    for (const auto& test : cases) {
        SCOPED_TRACE(test.language);
        fs::remove(desktop.Log());
        DialogRecorder dialogs;
        OpenUserGuide(install, test.language);
        const auto records = SettledRecords(desktop.Log());
        const std::string path = guides + test.folder + "/Veltrona.pdf";
        if (fs::exists(path)) {
            ASSERT_EQ(records.size(), 1u);
            EXPECT_EQ(records[0].args, std::vector<std::string>{path});
            EXPECT_TRUE(dialogs.Dialogs().empty());
        } else {
            EXPECT_TRUE(records.empty());
            ASSERT_EQ(dialogs.Dialogs().size(), 1u);
            EXPECT_EQ(dialogs.Dialogs()[0].message, "\"" + path + "\" not found.");
        }
    }
}

TEST(UserGuideTest, WithoutAReaderTheDialogAsksAgainOnlyAfterOK)
{
    const struct
    {
        int answer;
        bool installMeanwhile, asksAgain;
    } cases[] = {{wxID_OK, true, true}, {wxID_CANCEL, true, false}, {wxID_OK, false, false}};
    for (const auto& test : cases) {
        SCOPED_TRACE(test.answer);
        TestDesktop desktop;
        DialogRecorder dialogs([&](wxDialog*) {
            if (test.installMeanwhile)
                desktop.InstallReader();
            return test.answer;
        });
        OpenUserGuide();
        // This program's folder has no guide: once a reader is found, "not found." follows.
        ASSERT_EQ(dialogs.Dialogs().size(), test.asksAgain ? 2u : 1u);
        EXPECT_EQ(dialogs.Dialogs()[0].caption, "Acrobat Reader not found");
    }
}

TEST(UserGuideTest, ReaderLinkOpensItsAddressOrSaysWhyNot)
{
    TestDesktop desktop(VELTRONA_STANDIN_PATH);
    DialogRecorder dialogs;
    CAcrobatNotFoundDialog dialog(nullptr);
    dialog.Show();
    // Placed by the window manager and ready for the pointer once active.
    ASSERT_TRUE(WaitFor([&] { return dialog.IsActive(); }));
    // The title and the hint line are as high as their text in the real font.
    for (const wxWindowID id : {200, 210}) {
        const wxWindow* text = dialog.FindWindow(id);
        EXPECT_LE(text->GetTextExtent(text->GetLabel()).y, text->GetSize().y) << id;
    }
    wxUIActionSimulator pointer;
    pointer.MouseMove(dialog.m_link->GetScreenRect().GetLeftTop() + wxPoint(4, 4));
    pointer.MouseClick();
    const auto records = WaitForRecords(desktop.Log(), 1);
    ASSERT_EQ(records.size(), 1u);
    EXPECT_EQ(records[0].args, std::vector<std::string>{kReaderDownloadPage.ToStdString()});

    desktop.SetOpener("/bin/false");
    pointer.MouseClick();
    ASSERT_TRUE(WaitFor([&] { return !dialogs.Dialogs().empty(); }));
    EXPECT_EQ(dialogs.Dialogs()[0].message, "Failed to open the URL");
}

// The boxes as the screen shows them: the caption on the title bar in every language
// (wxGTK drops its own default "Message"), the icon of the style beside the text.
TEST(UserGuideTest, BoxesShowTheirCaptionAndIcon)
{
    wxFileSystem::AddHandler(new wxMemoryFSHandler);
    LoadCatalogResources();
    wxLocale::AddCatalogLookupPathPrefix("memory:.");
    const StandinDir install({});
    for (const auto& [lang, caption] :
         {std::pair{"en_US", "Message"}, std::pair{"fr_FR", "Message"},
          std::pair{"de_DE", "Meldung"}}) {
        SCOPED_TRACE(lang);
        const ScopedEnv env({{"LANG", lang + std::string(".UTF-8")}, {"LC_ALL", ""}});
        wxLocale locale;
        DecideUserLanguage();
        InitLocale(locale);
        locale.AddCatalog("Veltro");
        const ShownMessageBox box =
            ObserveMessageBox([&] { OpenUserGuide(install.Path() + "/", "en"); });
        ASSERT_TRUE(box.seen);
        EXPECT_EQ(box.title, caption);
        EXPECT_EQ(box.icon, "dialog-information");
    }

    TestDesktop desktop("/bin/false");
    const ShownMessageBox box = ObserveMessageBox([] { OpenURL(kHowToPage); });
    ASSERT_TRUE(box.seen);
    EXPECT_EQ(box.title, "Error");
    EXPECT_EQ(box.icon, "dialog-error");
    // The theme's error sign is red.
    ASSERT_TRUE(box.iconPixels.IsOk());
    const unsigned char* p = box.iconPixels.GetData();
    int red = 0;
    for (int i = box.iconPixels.GetWidth() * box.iconPixels.GetHeight(); i > 0; --i, p += 3)
        red += p[0] > 160 && p[1] < 90 && p[2] < 90;
    EXPECT_GT(red, 100);
}

// Real key presses on the shown dialog: the picture never has the focus, so Return
// ends it as OK does, Escape as a cancel.
TEST(UserGuideTest, ReaderDialogEndsWithReturnOrEscape)
{
    for (const auto& [key, result] :
         {std::pair{WXK_RETURN, int(wxID_OK)}, std::pair{WXK_ESCAPE, int(wxID_CANCEL)}}) {
        SCOPED_TRACE(key);
        CAcrobatNotFoundDialog dialog(nullptr);
        wxWindow* focused = nullptr;
        dialog.CallAfter([&] {
            ASSERT_TRUE(WaitFor([&] { return dialog.IsActive(); })) << "the dialog's activation";
            focused = wxWindow::FindFocus();
            wxUIActionSimulator().Char(key);
        });
        wxTimer guard;
        guard.Bind(wxEVT_TIMER, [&](wxTimerEvent&) { dialog.EndModal(-1); });
        guard.StartOnce(10000);
        EXPECT_EQ(dialog.ShowModal(), result);
        EXPECT_EQ(focused, dialog.FindWindow(140));
    }
}

} // namespace
