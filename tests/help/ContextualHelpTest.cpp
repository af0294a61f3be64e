// Contextual help: the application id of each product, and the launcher's help
// command as a user meets it, with the help viewer installed, missing, or
// installed but never answering.
#include "help/CContextualHelp.h"
#include "platform/Ipc.h"

#include "support/GuiWait.h"
#include "support/ProbeRun.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"
#include "support/ViewerLog.h"

#include <gtest/gtest.h>

#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <memory>
#include <sys/stat.h>

namespace {

namespace fs = std::filesystem;

TEST(ContextualHelpTest, ApplicationIdIsTheFirstMatchingProductsAndItsServiceIsRegistered)
{
    struct Case
    {
        const char* appName;
        const char* id;
    };
    const Case cases[] = {
        {"Veltrona", "LaunchPad"},
        {"Quenta Print Studio with Veltrona", "LaunchPad"},
        {"Quenta Print Studio and Quenta Link Studio", "LinkStudio"},
        {"Zel VerifyStudio 3", "VerifyAssist"},
        {"Quenta Display Studio", "DisplayStudio"},
        {"veltrona", ""},
        {"Zel Display Studio", ""},
    };
    StandinDir runtime({});
    chmod(runtime.Path().c_str(), 0700);
    setenv("XDG_RUNTIME_DIR", runtime.Path().c_str(), 1);
    for (const Case& c : cases) {
        SCOPED_TRACE(c.appName);
        CContextualHelp help(c.appName);
        help.Start();
        EXPECT_EQ(help.m_applicationId, c.id);
        EXPECT_EQ(help.m_serviceName, c.id);
        EXPECT_EQ(help.m_helpService, "Help");
        // An empty service name is refused: nothing is registered.
        EXPECT_EQ(help.m_server != nullptr, *c.id != '\0');
        if (*c.id) {
            EXPECT_TRUE(fs::exists(runtime.Path() + "/veltrona/" + c.id));
        }
    }
}

// Milliseconds that the help command took in the probe, -1 when it did not end.
long CommandMilliseconds(const ProbeRun& probe)
{
    const auto events = probe.Events("command");
    if (events.size() != 2)
        return -1;
    return std::stol(events[1].fields[1]) - std::stol(events[0].fields[1]);
}

TEST(ContextualHelpTest, HelpCommandShowsTheLauncherPageInTheViewer)
{
    enum class Viewer
    {
        Installed,
        Missing,
        Silent
    };
    struct Case
    {
        const char* what;
        Viewer viewer;
        long minMs, maxMs; // how long the command may keep the launcher busy
    };
    const Case cases[] = {
        {"viewer installed", Viewer::Installed, 0, 10000},
        {"viewer missing", Viewer::Missing, 0, 1000},
        {"viewer that never serves", Viewer::Silent, 9500, 13000},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.what);
        StandinDir install(c.viewer == Viewer::Silent
                               ? std::vector<std::string>{"Help/Veltrona Help.exe"}
                               : std::vector<std::string>{});
        if (c.viewer == Viewer::Installed) {
            fs::create_directories(install.Path() + "/Help");
            fs::create_symlink(VELTRONA_HELPVIEWER_PATH,
                               install.Path() + "/Help/Veltrona Help.exe");
            fs::create_directories(install.Path() + "/Documentation/en/Help");
            std::ofstream(install.Path() + "/Documentation/en/Help/Launcher.html")
                << "<p>Launcher</p>";
        }
        // The launcher finds the viewer beside its own executable, not beside a link to it.
        fs::create_hard_link(VELTRONA_PROBE_PATH, install.Path() + "/Veltrona.exe");
        StandinDir runtime({});
        chmod(runtime.Path().c_str(), 0700);
        const std::string starts = install.Path() + "/starts.log",
                          pokes = install.Path() + "/viewer.log";
        ProbeRun launcher(install.Path(), {},
                          {{"XDG_RUNTIME_DIR", runtime.Path()},
                           {"VELTRONA_STANDIN_LOG", starts},
                           {"VELTRONA_HELP_LOG", pokes},
                           {"VELTRONA_PROBE_COMMAND", "1015"}});
        ASSERT_TRUE(WaitFor([&] { return CommandMilliseconds(launcher) >= 0; }, 30000));
        const long ms = CommandMilliseconds(launcher);
        EXPECT_GE(ms, c.minMs);
        EXPECT_LE(ms, c.maxMs);

        const auto viewers = ReadRecords(starts);
        std::shared_ptr<void> stopViewers(nullptr, [viewers](void*) {
            for (const StandinRecord& viewer : viewers)
                kill(viewer.pid, SIGKILL);
        });
        if (c.viewer == Viewer::Missing) {
            EXPECT_TRUE(viewers.empty());
            continue;
        }
        ASSERT_EQ(viewers.size(), 1u);
        EXPECT_EQ(viewers[0].exe, install.Path() + "/Help/Veltrona Help.exe");
        EXPECT_EQ(viewers[0].cwd, install.Path());
        EXPECT_TRUE(viewers[0].args.empty());
        if (c.viewer == Viewer::Silent)
            continue;

        ASSERT_TRUE(WaitFor([&] { return ReadViewerLog(pokes).size() >= 2; }));
        const auto log = ReadViewerLog(pokes);
        EXPECT_EQ(log[0], (ViewerLine{"poke", "Application", "LaunchPad$Launcher.html"}));
        EXPECT_EQ(log[1],
                  (ViewerLine{"page", install.Path() + "/Documentation/en/Help/Launcher.html"}));

        // The viewer may talk back on the launcher's own service; only "IPC START" is served.
        setenv("XDG_RUNTIME_DIR", runtime.Path().c_str(), 1);
        IpcClient client;
        EXPECT_EQ(client.Connect("LaunchPad", "Application"), nullptr);
        std::unique_ptr<wxConnectionBase> toLauncher(client.Connect("LaunchPad", "IPC START"));
        ASSERT_NE(toLauncher, nullptr);
        EXPECT_TRUE(toLauncher->Poke("Application", wxString("Exit")));
        toLauncher.reset();
        int status = 0;
        EXPECT_FALSE(launcher.WaitForExit(500, status)) << "the launcher ended on Exit";
        EXPECT_TRUE(launcher.Events("dialog").empty());
    }
}

} // namespace
