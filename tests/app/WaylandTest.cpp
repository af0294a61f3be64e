// The launcher on a Wayland desktop (headless weston): through XWayland beside
// its X11 modules, and on Wayland itself with no input seat.
#include "frame/Veltro3AppFrame.h"

#include "support/DesktopTools.h"
#include "support/GuiWait.h"
#include "support/ProbeRun.h"
#include "support/ScopedEnv.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"
#include "support/WestonServer.h"

#include <gtest/gtest.h>
#include <wx/filefn.h>
#include <wx/menu.h>
#include <wx/utils.h>

#include <csignal>
#include <filesystem>

namespace {

TEST(WaylandTest, RunsThroughXWaylandBesideItsModules)
{
    WestonServer weston(1280, 1024, true);
    ASSERT_TRUE(weston.Ready());
    StandinDir install({"ZelVerifyStudio.exe", "Quenta Inspect Studio.exe"});
    const std::string log = install.Path() + "/starts.log", ready = install.Path() + "/ready";
    // Everything below sees the Wayland session; the test's own toolkit stays on Xvfb.
    ScopedEnv session({{"XDG_RUNTIME_DIR", weston.RuntimeDir()},
                       {"WAYLAND_DISPLAY", weston.Socket()},
                       {"DISPLAY", weston.Display()}});
    long verify = 0;
    {
        ScopedEnv env({{"VELTRONA_STANDIN_LOG", ready + ".log"},
                       {"VELTRONA_STANDIN_EXIT", "0"},
                       {"VELTRONA_STANDIN_READY", ready}});
        verify = wxExecute(wxString(install.Path() + "/ZelVerifyStudio.exe"), wxEXEC_ASYNC);
    }
    ASSERT_TRUE(verify > 0 && WaitFor([&] { return wxFileExists(ready); }));

    const std::string profile = install.Path() + "/profile.icc";
    ProbeRun launcher(install.Path(), {profile},
                      {{"XDG_RUNTIME_DIR", weston.RuntimeDir()},
                       {"VELTRONA_STANDIN_LOG", log},
                       {"VELTRONA_STANDIN_EXIT", "1"},
                       {"VELTRONA_PROBE_COMMAND", "1004"}});
    ASSERT_TRUE(launcher.WaitForShown());
    // An X11 window on XWayland: the menu bar over the whole client area.
    const unsigned long frame = launcher.Window();
    auto* reference = new Veltro3AppFrame("Veltrona", wxDefaultPosition, wxDefaultSize);
    reference->Show();
    const int menuBar = reference->GetMenuBar()->GetSize().y;
    reference->Destroy();
    EXPECT_EQ(WindowRect(frame).GetSize(), wxSize(564, menuBar + 344)) << menuBar;

    // Verify found, not started again (headless weston activates nothing and ignores raise
    // requests, so the raise itself shows nowhere); the file reached Inspect.
    ASSERT_TRUE(WaitFor([&] { return launcher.Events("command").size() == 2; }));
    launcher.Kill(SIGKILL);
    launcher.WaitForExit();
    wxKill(verify, wxSIGKILL);
    const auto records = SettledRecords(log, weston.Pid());
    ASSERT_EQ(records.size(), 1u);
    EXPECT_EQ(records[0].exe, install.Path() + "/Quenta Inspect Studio.exe");
    EXPECT_EQ(records[0].args, std::vector<std::string>{profile});
}

// Forced onto Wayland with no seat: the screen check refuses without its message
// (nobody could answer it), and a launcher that runs shows its whole view and ends cleanly.
TEST(WaylandTest, RunsAndEndsWithoutAnInputSeat)
{
    const struct
    {
        int width, height;
        bool runs;
    } cases[] = {{800, 600, false}, {1280, 1024, true}};
    for (const auto& c : cases) {
        WestonServer weston(c.width, c.height, false);
        ASSERT_TRUE(weston.Ready());
        StandinDir install({});
        // The real launcher: the probe answers message boxes before the toolkit shows them.
        if (!c.runs)
            std::filesystem::copy_file(VELTRONA_LAUNCHER_PATH, install.Path() + "/Veltrona.exe");
        ProbeRun launcher(install.Path(), {},
                          {{"XDG_RUNTIME_DIR", weston.RuntimeDir()},
                           {"WAYLAND_DISPLAY", weston.Socket()},
                           {"GDK_BACKEND", "wayland"},
                           {"VELTRONA_PROBE_COMMAND", "1007"}});
        const int code = launcher.ExitCode(20000);
        ASSERT_TRUE(code >= 0 && code < 256) << c.width << ": " << code;
        EXPECT_EQ(code == 0, c.runs);
        EXPECT_EQ(launcher.Events("shown").size(), c.runs ? 2u : 0u);
        // GTK's own decorations do not eat into the view.
        for (const ProbeEvent& e : launcher.Events("placed"))
            if (e.fields[0] == "Veltrona") {
                EXPECT_EQ(e.fields[3] + " x " + e.fields[4], "564 x 344");
            }
    }
}

} // namespace
