// The version reader over real PE files linked by the mingw tools and ELF files carrying compiled
// resources; the About Modules lines and the module window on the real display.
#include "about/ModuleInfo.h"
#include "about/ModuleSplash.h"
#include "about/VersionInfo.h"
#include "platform/ScreenCapture.h"
#include "support/GuiWait.h"
#include "support/StandinDir.h"

#include <gtest/gtest.h>
#include <gtk/gtk.h>

#include <wx/filefn.h>
#include <wx/uiaction.h>
#include <wx/weakref.h>

#include <algorithm>
#include <stdexcept>

namespace {

const std::string kNotFound = "VersionInfo: can not find the file.";

// The formatted product version, or the message of the error thrown.
std::string Read(const std::string& path)
{
    try {
        return VersionInfo(path).FormatVersion().utf8_string();
    } catch (const std::runtime_error& error) {
        return error.what();
    }
}

} // namespace

TEST(VersionInfo, ReadsTheProductVersionNotTheFileVersion)
{
    // The file versions are 9.8.7.6, 3.0.21.10 and 1.2.3.4000.
    const std::pair<const char*, std::string> cases[] = {
        {"pe-3.0.21.7", "3.0.21.07"}, {"pe-3.0.21.10", "3.0.21.10"}, {"elf-1.2.3.0", "1.2.3.00"},
        {"pe-no-version", kNotFound}, {"elf-no-version", kNotFound}, {"missing", kNotFound},
    };
    for (const auto& [file, expected] : cases)
        EXPECT_EQ(Read(VELTRONA_VERSION_FILES "/" + std::string(file)), expected) << file;
    EXPECT_EQ(GetLauncherVersion(), "3.1.2.01");
}

TEST(ModuleInfo, LinesShowTheProductVersionOrNA)
{
    StandinDir install({});
    ASSERT_TRUE(wxCopyFile(VELTRONA_VERSION_FILES "/pe-3.0.21.7",
                           install.Path() + "/Quenta Print Studio.exe"));
    wxSetWorkingDirectory(install.Path());
    const wxArrayString print = ModuleInfoLines(1025), verify = ModuleInfoLines(1030);
    ASSERT_TRUE(print.size() == 7 && verify.size() == 7);
    EXPECT_EQ(print[2] + "|" + print[3], "Quenta Print Studio|Version 3.0.21.07");
    EXPECT_EQ(verify[2] + "|" + verify[3], "Zel Verify Studio|Version N/A") << "not installed";
    EXPECT_TRUE(ModuleInfoLines(1024).empty());
}

TEST(ModuleInfo, WindowIsCentredReadableInADarkThemeAndClosesAtTheFirstPressAnywhereOrKey)
{
    // GTK reads GTK_THEME again whenever the theme changes.
    setenv("GTK_THEME", "Adwaita:dark", 1);
    g_object_set(gtk_settings_get_default(), "gtk-theme-name", "Adwaita", nullptr);
    wxUIActionSimulator input;
    for (const std::string action : {"press on it", "press elsewhere", "key"}) {
        // The user opens the window from the menu: the window manager sees input first.
        input.MouseClick();
        const wxWeakRef<ZelModuleSplashScreen> window(
            new ZelModuleSplashScreen(-1, ModuleInfoLines(1025)));
        const wxRect area = window->GetScreenRect();
        EXPECT_EQ(area, wxRect(420, 462, 440, 100)) << action;
        ASSERT_GT(window->GetForegroundColour().GetLuminance(), 0.5) << "the theme's text is light";
        // Once the paper shows at its right end, the name on it (y 20 to 32) is dark.
        EXPECT_TRUE(WaitFor([&] {
            const wxImage shot = CaptureScreen(area);
            int darkest = 255;
            for (int x = 140; shot.IsOk() && shot.GetGreen(420, 50) > 200 && x < 400; ++x)
                for (int y = 20; y < 32; ++y)
                    darkest = std::min(darkest, int(shot.GetGreen(x, y)));
            return darkest < 80;
        })) << action;
        EXPECT_TRUE(window->HasCapture()) << action;
        ASSERT_TRUE(WaitFor([&] { return window->IsActive(); })) << action;
        if (action == "key") {
            input.Char('x');
        } else {
            input.MouseMove(action == "press on it" ? area.GetPosition() + wxPoint(20, 20)
                                                    : wxPoint(5, 5));
            input.MouseClick();
        }
        EXPECT_TRUE(WaitFor([&] { return !window || !window->IsShown(); }, 2500)) << action;
        EXPECT_EQ(wxWindow::GetCapture(), nullptr) << action;
    }
}
