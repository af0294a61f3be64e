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
#include <filesystem>
#include <memory>
#include <set>
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

// Found through PATH, through a link elsewhere, or by its path: the launcher
// works from its own folder, and a relative file is the caller's.
TEST_F(StartupTest, WorksFromItsOwnFolderAndOpensTheCallersFile)
{
    const std::string install = m_install.Path();
    StandinDir profiles({}), links({});
    using Args = std::vector<std::string>;
    const struct
    {
        ProbeStart start;
        Args args;
        Args opened; // Inspect's arguments; none when nothing opens
    } cases[] = {
        {{install + "/Veltrona.exe", "Veltrona.exe", profiles.Path()},
         {"x.icc"},
         {profiles.Path() + "/x.icc"}},
        {{links.Path() + "/veltrona", "", profiles.Path()},
         {"./a b/\"c\".icc", "second.icc"},
         {profiles.Path() + "/a b/\"c\".icc"}},
        {{"", "", profiles.Path()}, {"\xff\xfe.icc", "second.icc"}, {}},
    };

    std::vector<std::unique_ptr<StandinDir>> runtimes;
    std::vector<std::unique_ptr<ProbeRun>> runs;
    for (const auto& c : cases) {
        runtimes.push_back(std::make_unique<StandinDir>(std::vector<std::string>{}));
        chmod(runtimes.back()->Path().c_str(), 0700);
        EnvList env = Env();
        env[0].second = runtimes.back()->Path();
        env.emplace_back("PATH", install + ":" + std::getenv("PATH"));
        runs.push_back(std::make_unique<ProbeRun>(install, c.args, env, c.start));
        std::error_code exists;
        std::filesystem::create_symlink(install + "/Veltrona.exe", links.Path() + "/veltrona",
                                        exists);
    }
    std::multiset<Args> expected;
    for (size_t i = 0; i < runs.size(); ++i) {
        ASSERT_TRUE(runs[i]->WaitForShown()) << i;
        // The untitled start-up splash first, the frame no earlier than 2000 ms after it.
        const auto shown = runs[i]->Events("shown");
        ASSERT_EQ(shown.size(), 2u) << i;
        EXPECT_EQ(shown[0].fields[0], "");
        EXPECT_EQ(shown[1].fields[0], "Veltrona");
        EXPECT_GE(std::stol(shown[1].fields[1]) - std::stol(shown[0].fields[1]), 2000);
        unsigned long frame = 0;
        ASSERT_TRUE(WaitFor([&] { return (frame = WindowOf(runs[i]->Pid(), "Veltrona")) != 0; }));
        CloseWindow(frame);
        int status = 0;
        ASSERT_TRUE(runs[i]->WaitForExit(10000, status)) << i;
        if (!cases[i].opened.empty())
            expected.insert(cases[i].opened);
    }

    std::multiset<Args> opened;
    for (const StandinRecord& record : SettledRecords(install + "/starts.log")) {
        EXPECT_EQ(record.exe, install + "/Quenta Inspect Studio.exe");
        EXPECT_EQ(record.cwd, install);
        opened.insert(record.args);
    }
    EXPECT_EQ(opened, expected);
}

TEST_F(StartupTest, CloseBoxEndsTheLauncher)
{
    ProbeRun launcher(m_install.Path(), {}, Env());
    ASSERT_TRUE(launcher.WaitForShown());
    unsigned long frame = 0;
    ASSERT_TRUE(WaitFor([&] { return (frame = WindowOf(launcher.Pid(), "Veltrona")) != 0; }));
    CloseWindow(frame);
    int status = 0;
    ASSERT_TRUE(launcher.WaitForExit(10000, status));
    EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
    EXPECT_TRUE(launcher.Events("dialog").empty());
}

} // namespace
