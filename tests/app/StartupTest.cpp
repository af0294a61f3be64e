// Start-up and shutdown of the real launcher, run as its own process.
#include "support/DesktopTools.h"
#include "support/GuiWait.h"
#include "support/ProbeRun.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"
#include "support/XvfbServer.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <memory>
#include <set>
#include <sys/wait.h>

namespace {

using Args = std::vector<std::string>;

TEST(StartupTest, ScreenOfAtLeast1024By768IsRequired)
{
    StandinDir install({});
    XvfbServer small(1280, 720), exact(1024, 768);
    ASSERT_FALSE(small.Display().empty() || exact.Display().empty());
    ProbeRun refused(install.Path(), {},
                     {{"XDG_RUNTIME_DIR", install.Path()}, {"DISPLAY", small.Display()}});
    int status = 0;
    ASSERT_TRUE(refused.WaitForExit(20000, status));
    EXPECT_FALSE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
    const auto events = refused.Events();
    ASSERT_EQ(events.size(), 1u) << "one message, no window";
    EXPECT_EQ(events[0].fields[0], "Please set your monitor to a supported resolution.\n"
                                   "Minimum required: 1024 x 768");

    ProbeRun accepted(install.Path(), {},
                      {{"XDG_RUNTIME_DIR", install.Path()}, {"DISPLAY", exact.Display()}});
    EXPECT_TRUE(accepted.WaitForShown());
    EXPECT_TRUE(accepted.Events("dialog").empty());
}

// Found through PATH, through a link elsewhere, or by its path: the launcher
// works from its own folder, opens the caller's file, and its close box ends it.
TEST(StartupTest, WorksFromItsOwnFolderAndOpensTheCallersFile)
{
    StandinDir installDir({"Quenta Inspect Studio.exe"}), profilesDir({});
    const std::string install = installDir.Path(), profiles = profilesDir.Path();
    std::filesystem::create_symlink(install + "/Veltrona.exe", profiles + "/veltrona");
    const struct
    {
        ProbeStart start;
        Args args;
        Args opened; // Inspect's arguments; none when nothing opens
    } cases[] = {
        {{install + "/Veltrona.exe", "Veltrona.exe", profiles}, {"x.icc"}, {profiles + "/x.icc"}},
        {{profiles + "/veltrona", "", profiles},
         {"./a b/\"c\".icc", "second.icc"},
         {profiles + "/a b/\"c\".icc"}},
        {{"", "", profiles}, {"\xff\xfe.icc", "second.icc"}, {}},
    };

    std::vector<std::unique_ptr<ProbeRun>> runs;
    std::multiset<Args> expected;
    for (const auto& c : cases) {
        // A runtime directory of its own, so that each copy runs.
        const std::string runtime = install + "/run" + std::to_string(runs.size());
        std::filesystem::create_directory(runtime);
        runs.push_back(
            std::make_unique<ProbeRun>(install, c.args,
                                       EnvList{{"XDG_RUNTIME_DIR", runtime},
                                               {"VELTRONA_STANDIN_LOG", install + "/starts.log"},
                                               {"VELTRONA_STANDIN_EXIT", "1"},
                                               {"PATH", install + ":" + std::getenv("PATH")}},
                                       c.start));
        if (!c.opened.empty())
            expected.insert(c.opened);
    }
    for (auto& run : runs) {
        ASSERT_TRUE(run->WaitForShown());
        // The untitled start-up splash first, the frame no earlier than 2000 ms after it.
        const auto shown = run->Events("shown");
        ASSERT_EQ(shown.size(), 2u);
        EXPECT_EQ(shown[0].fields[0], "");
        EXPECT_GE(std::stol(shown[1].fields[1]) - std::stol(shown[0].fields[1]), 2000);
        unsigned long frame = 0;
        ASSERT_TRUE(WaitFor([&] { return (frame = WindowOf(run->Pid(), "Veltrona")) != 0; }));
        CloseWindow(frame);
        int status = 0;
        ASSERT_TRUE(run->WaitForExit(10000, status));
        EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0);
        EXPECT_TRUE(run->Events("dialog").empty());
    }

    std::multiset<Args> opened;
    for (const StandinRecord& record : SettledRecords(install + "/starts.log")) {
        EXPECT_EQ(record.exe, install + "/Quenta Inspect Studio.exe");
        EXPECT_EQ(record.cwd, install);
        opened.insert(record.args);
    }
    EXPECT_EQ(opened, expected);
}

} // namespace
