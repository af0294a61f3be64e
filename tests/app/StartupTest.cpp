// Start-up and shutdown of the real launcher, run as its own process.
#include "support/DesktopTools.h"
#include "support/GuiWait.h"
#include "support/ProbeRun.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"
#include "support/XvfbServer.h"

#include <gtest/gtest.h>
#include <wx/defs.h>

#include <cstdlib>
#include <sys/stat.h>
#include <sys/wait.h>

namespace {

// An installation with the Inspect stand-in, and a private runtime directory
// so that no other copy of the launcher is seen.
class StartupTest : public testing::Test
{
protected:
    StartupTest() : m_install({"Quenta Inspect Studio.exe"}), m_runtime({})
    {
        chmod(m_runtime.Path().c_str(), 0700);
    }

    EnvList Env(const std::string& display = std::string()) const
    {
        EnvList env = {{"XDG_RUNTIME_DIR", m_runtime.Path()},
                       {"VELTRONA_STANDIN_LOG", m_install.Path() + "/starts.log"},
                       {"VELTRONA_STANDIN_EXIT", "1"}};
        if (!display.empty())
            env.emplace_back("DISPLAY", display);
        return env;
    }

    StandinDir m_install;
    StandinDir m_runtime;
};

TEST_F(StartupTest, ScreenOfAtLeast1024By768IsRequired)
{
    XvfbServer small(1280, 720);
    ASSERT_FALSE(small.Display().empty());
    ProbeRun refused(m_install.Path(), {}, Env(small.Display()));
    int status = 0;
    ASSERT_TRUE(refused.WaitForExit(20000, status));
    EXPECT_FALSE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
    const auto dialogs = refused.Events("dialog");
    ASSERT_EQ(dialogs.size(), 1u);
    EXPECT_EQ(dialogs[0].fields[0], "Please set your monitor to a supported resolution.\n"
                                    "Minimum required: 1024 x 768");
    EXPECT_EQ(dialogs[0].fields[1], "");
    const long style = std::stol(dialogs[0].fields[2]);
    EXPECT_EQ(style & (wxOK | wxCENTRE | wxCANCEL | wxYES_NO), wxOK | wxCENTRE);
    EXPECT_TRUE(refused.Events("shown").empty());

    XvfbServer exact(1024, 768);
    ASSERT_FALSE(exact.Display().empty());
    ProbeRun accepted(m_install.Path(), {}, Env(exact.Display()));
    EXPECT_TRUE(accepted.WaitForShown());
    EXPECT_TRUE(accepted.Events("dialog").empty());
}

TEST_F(StartupTest, FrameShowsAfterTheSplashTimeAndOpensTheFirstArgument)
{
    const std::string file = m_install.Path() + "/my profile.icc";
    ProbeRun launcher(m_install.Path(), {file, "/ignored/second.icc"}, Env());
    ASSERT_TRUE(WaitFor([&] { return launcher.Events("shown").size() >= 2; }, 20000));
    // The untitled start-up splash first, the frame no earlier than 2000 ms after it.
    const auto shown = launcher.Events("shown");
    ASSERT_EQ(shown.size(), 2u);
    EXPECT_EQ(shown[0].fields[0], "");
    EXPECT_EQ(shown[1].fields[0], "Veltrona");
    EXPECT_GE(std::stol(shown[1].fields[1]) - std::stol(shown[0].fields[1]), 2000);

    const auto records = WaitForRecords(m_install.Path() + "/starts.log", 1, 10000);
    ASSERT_EQ(records.size(), 1u);
    EXPECT_EQ(records[0].exe, m_install.Path() + "/Quenta Inspect Studio.exe");
    EXPECT_EQ(records[0].args, std::vector<std::string>{file});
    EXPECT_EQ(records[0].cwd, m_install.Path());
}

TEST_F(StartupTest, CloseBoxEndsTheLauncher)
{
    ProbeRun launcher(m_install.Path(), {}, Env());
    ASSERT_TRUE(WaitFor([&] { return launcher.Events("shown").size() >= 2; }, 20000));
    unsigned long frame = 0;
    ASSERT_TRUE(WaitFor([&] { return (frame = WindowOf(launcher.Pid(), "Veltrona")) != 0; }));
    CloseWindow(frame);
    int status = 0;
    ASSERT_TRUE(launcher.WaitForExit(10000, status));
    EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
    EXPECT_TRUE(launcher.Events("dialog").empty());
}

} // namespace
