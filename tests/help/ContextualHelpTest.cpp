// Contextual help: the application id of each product, and the launcher's help
// command as a user meets it, with the help viewer installed, missing, or
// installed but never answering.
#include "help/CContextualHelp.h"
#include "platform/Ipc.h"

#include "support/GuiWait.h"
#include "support/ProbeRun.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gtest/gtest.h>

#include <csignal>
#include <filesystem>
#include <fstream>
#include <memory>
#include <sys/stat.h>

namespace {

namespace fs = std::filesystem;

TEST(ContextualHelpTest, FirstMatchingProductGivesTheIdAndTheService)
{
    const std::pair<const char*, const char*> cases[] = {
        {"Veltrona", "LaunchPad"},
        {"Quenta Print Studio with Veltrona", "LaunchPad"},
        {"Quenta Print Studio and Quenta Link Studio", "LinkStudio"},
        {"Zel VerifyStudio 3", "VerifyAssist"},
        {"veltrona", ""},
    };
    StandinDir runtime({});
    chmod(runtime.Path().c_str(), 0700);
    setenv("XDG_RUNTIME_DIR", runtime.Path().c_str(), 1);
    for (const auto& [appName, id] : cases) {
        CContextualHelp help(appName);
        help.Start();
        EXPECT_EQ(help.m_applicationId + "/" + help.m_serviceName + "/" + help.m_helpService,
                  wxString(id) + "/" + id + "/Help");
        // An empty service name is refused.
        EXPECT_EQ(help.m_server != nullptr, *id != '\0') << appName;
    }
}

TEST(ContextualHelpTest, HelpCommandShowsTheLauncherPageInTheViewer)
{
    enum Viewer
    {
        Installed,
        Missing,
        Silent
    };
    const struct
    {
        Viewer viewer;
        long minMs, maxMs; // how long the command keeps the launcher busy
    } cases[] = {{Installed, 0, 10000}, {Missing, 0, 1000}, {Silent, 9500, 13000}};
    for (const auto& c : cases) {
        SCOPED_TRACE(c.viewer);
        StandinDir install(c.viewer == Silent ? std::vector<std::string>{"Help/Veltrona Help.exe"}
                                              : std::vector<std::string>{});
        const std::string page = install.Path() + "/Documentation/en/Help/Launcher.html";
        if (c.viewer == Installed) {
            fs::create_directories(install.Path() + "/Help");
            fs::create_symlink(VELTRONA_HELPVIEWER_PATH,
                               install.Path() + "/Help/Veltrona Help.exe");
            fs::create_directories(fs::path(page).parent_path());
            std::ofstream(page) << "<p>Launcher</p>";
        }
        // The viewer is looked for beside the executable itself, not beside a link to it.
        fs::create_hard_link(VELTRONA_PROBE_PATH, install.Path() + "/Veltrona.exe");
        StandinDir runtime({});
        chmod(runtime.Path().c_str(), 0700);
        const std::string starts = install.Path() + "/starts.log",
                          log = install.Path() + "/viewer.log";
        ProbeRun launcher(install.Path(), {},
                          {{"XDG_RUNTIME_DIR", runtime.Path()},
                           {"VELTRONA_STANDIN_LOG", starts},
                           {"VELTRONA_HELP_LOG", log},
                           {"VELTRONA_PROBE_COMMAND", "1015"}});
        ASSERT_TRUE(WaitFor([&] { return launcher.Events("command").size() == 2; }, 30000));
        const auto command = launcher.Events("command");
        const long ms = std::stol(command[1].fields[1]) - std::stol(command[0].fields[1]);
        EXPECT_TRUE(ms >= c.minMs && ms <= c.maxMs) << ms << " ms";

        const auto viewers = ReadRecords(starts);
        std::shared_ptr<void> stop(nullptr, [viewers](void*) {
            for (const StandinRecord& viewer : viewers)
                kill(viewer.pid, SIGKILL);
        });
        ASSERT_EQ(viewers.size(), c.viewer == Missing ? 0u : 1u);
        if (c.viewer == Missing)
            continue;
        EXPECT_EQ(viewers[0].exe, install.Path() + "/Help/Veltrona Help.exe");
        EXPECT_EQ(viewers[0].cwd, install.Path());
        if (c.viewer == Silent)
            continue;
        ASSERT_TRUE(WaitFor([&] { return ReadEventLog(log).size() >= 2; }));
        const auto events = ReadEventLog(log);
        EXPECT_EQ(events[0].fields,
                  (std::vector<std::string>{"Application", "LaunchPad$Launcher.html"}));
        EXPECT_EQ(events[1].fields, std::vector<std::string>{page});

        // The viewer may talk back on the launcher's service: "Exit" changes nothing.
        setenv("XDG_RUNTIME_DIR", runtime.Path().c_str(), 1);
        IpcClient client;
        EXPECT_EQ(client.Connect("LaunchPad", "Application"), nullptr);
        std::unique_ptr<wxConnectionBase> toLauncher(client.Connect("LaunchPad", "IPC START"));
        ASSERT_NE(toLauncher, nullptr);
        toLauncher->Poke("Application", wxString("Exit"));
        toLauncher.reset();
        int status = 0;
        EXPECT_FALSE(launcher.WaitForExit(500, status));
        EXPECT_TRUE(launcher.Events("dialog").empty());
    }
}

} // namespace
