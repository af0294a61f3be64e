// Contextual help as a user meets it: the launcher's help command with the help
// viewer installed or missing. (A viewer that never answers: RaiseServiceTest.)
#include "support/GuiWait.h"
#include "support/ProbeRun.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gtest/gtest.h>

#include <csignal>
#include <filesystem>
#include <fstream>
#include <memory>

namespace {

namespace fs = std::filesystem;

TEST(ContextualHelpTest, HelpCommandShowsTheLauncherPageInTheViewer)
{
    for (const std::string viewer : {VELTRONA_HELPVIEWER_PATH, ""}) {
        SCOPED_TRACE(viewer);
        StandinDir install({}), runtime({});
        const std::string page = install.Path() + "/Documentation/en/Help/Launcher.html";
        fs::create_directories(fs::path(page).parent_path());
        std::ofstream(page) << "<p>Launcher</p>";
        if (!viewer.empty()) {
            fs::create_directories(install.Path() + "/Help");
            fs::create_symlink(viewer, install.Path() + "/Help/Veltrona Help.exe");
        }
        // The viewer is looked for beside the executable itself, not beside a link to it.
        fs::create_hard_link(VELTRONA_PROBE_PATH, install.Path() + "/Veltrona.exe");
        const std::string starts = install.Path() + "/starts.log",
                          log = install.Path() + "/viewer.log";
        ProbeRun launcher(install.Path(), {},
                          {{"XDG_RUNTIME_DIR", runtime.Path()},
                           {"VELTRONA_STANDIN_LOG", starts},
                           {"VELTRONA_HELP_LOG", log},
                           {"VELTRONA_PROBE_COMMAND", "1015"}});
        ASSERT_TRUE(WaitFor([&] { return launcher.Events("command").size() == 2; }, 30000));
        const auto viewers = viewer.empty() ? ReadRecords(starts) : WaitForRecords(starts, 1);
        std::shared_ptr<void> stop(nullptr, [viewers](void*) {
            for (const StandinRecord& viewer : viewers)
                kill(viewer.pid, SIGKILL);
        });
        ASSERT_EQ(viewers.size(), viewer.empty() ? 0u : 1u);
        if (viewer.empty())
            continue;
        EXPECT_EQ(viewers[0].exe, install.Path() + "/Help/Veltrona Help.exe");
        EXPECT_EQ(viewers[0].cwd, install.Path());
        ASSERT_TRUE(WaitFor([&] { return ReadEventLog(log).size() >= 2; }));
        const auto events = ReadEventLog(log);
        EXPECT_EQ(events[0].fields,
                  (std::vector<std::string>{"Application", "LaunchPad$Launcher.html"}));
        EXPECT_EQ(events[1].fields, std::vector<std::string>{page});
    }
}

} // namespace
