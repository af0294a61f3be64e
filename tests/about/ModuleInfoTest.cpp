// The About Modules lines for installed and missing modules, and the module window on the
// real display.
#include "about/ModuleInfo.h"
#include "about/ModuleSplash.h"
#include "support/GuiWait.h"

#include <gtest/gtest.h>

#include <wx/filename.h>
#include <wx/fs_mem.h>
#include <wx/uiaction.h>

#include <cstdlib>

namespace {

ZelModuleSplashScreen* OpenModuleWindow()
{
    for (wxWindow* window : wxTopLevelWindows)
        if (auto* module = dynamic_cast<ZelModuleSplashScreen*>(window))
            if (!module->IsBeingDeleted() && module->IsShown())
                return module;
    return nullptr;
}

} // namespace

TEST(ModuleInfo, LinesShowTheProductVersionOrNA)
{
    const wxString dir = wxFileName::CreateTempFileName(testing::TempDir() + "modules");
    wxRemoveFile(dir);
    ASSERT_TRUE(wxMkdir(dir));
    ASSERT_TRUE(
        wxCopyFile(VELTRONA_VERSION_FILES "/pe-3.0.21.7", dir + "/Quenta Print Studio.exe"));
    const wxString previous = wxGetCwd();
    wxSetWorkingDirectory(dir);
    const wxArrayString printer = ModuleInfoLines(1025);
    const wxArrayString verify = ModuleInfoLines(1030);
    const wxArrayString none = ModuleInfoLines(1024);
    wxSetWorkingDirectory(previous);
    std::system(("rm -rf '" + dir + "'").c_str());

    const char* expected[] = {"",
                              "",
                              "Quenta Print Studio",
                              "Version 3.0.21.07",
                              "Copyright 2005-2012 Zelgrave, Quenta Group",
                              "All rights reserved.",
                              ""};
    ASSERT_EQ(printer.size(), 7u);
    for (size_t i = 0; i < printer.size(); ++i)
        EXPECT_EQ(printer[i], expected[i]) << i;
    ASSERT_EQ(verify.size(), 7u);
    EXPECT_EQ(verify[2], "Zel Verify Studio");
    EXPECT_EQ(verify[3], "Version N/A");
    EXPECT_TRUE(none.empty());
}

TEST(ModuleInfo, WindowIsCentredAndClosesAtTheFirstPressAnywhereOrKey)
{
    wxUIActionSimulator input;
    for (const std::string action : {"press on it", "press elsewhere", "key"}) {
        // The user opens the window from the menu: the window manager sees input first.
        input.MouseClick();
        {
            wxArrayString lines(1, wxString("Quenta Print Studio"));
            new ZelModuleSplashScreen(-1, lines);
        }
        ZelModuleSplashScreen* window = OpenModuleWindow();
        ASSERT_NE(window, nullptr) << action;
        const wxRect area = window->GetScreenRect();
        EXPECT_EQ(area, wxRect((1280 - 440) / 2, (1024 - 100) / 2, 440, 100)) << action;
        EXPECT_TRUE(window->HasCapture()) << action;
        ASSERT_TRUE(WaitFor([&] { return window->IsActive(); })) << action;
        if (action == "key") {
            input.Char('x');
        } else {
            input.MouseMove(action == "press on it" ? area.GetPosition() + wxPoint(20, 20)
                                                    : wxPoint(5, 5));
            input.MouseClick();
        }
        EXPECT_TRUE(WaitFor([] { return OpenModuleWindow() == nullptr; }, 2500)) << action;
        EXPECT_EQ(wxWindow::GetCapture(), nullptr) << action;
    }
}

TEST(ModuleInfo, MissingPictureStillOpensAndCloses)
{
    ASSERT_TRUE(LoadCommonBitmap("Helper::ModuleSplash").IsOk());
    wxMemoryFSHandler::RemoveFile("XRC_resource/CommonImages$images_modulesplash_zel.png");
    ShowModuleInfo(1025);
    ZelModuleSplashScreen* window = OpenModuleWindow();
    ASSERT_NE(window, nullptr);
    EXPECT_TRUE(window->HasCapture());
    wxUIActionSimulator().MouseClick();
    EXPECT_TRUE(WaitFor([] { return OpenModuleWindow() == nullptr; }, 2500));
}
