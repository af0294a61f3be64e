// The module stand-in itself: its start record must round-trip whatever the
// launcher hands it, and its window must look like the module it stands for.
// GoogleTest comes before Xlib, whose macros (None, Bool) break its headers.
#include <gtest/gtest.h>

#include "support/GuiWait.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"
#include "support/X11Client.h"

#include <X11/Xatom.h>
#include <X11/Xlib.h>
#include <X11/Xutil.h>

#include <csignal>
#include <fstream>
#include <map>
#include <spawn.h>
#include <sstream>
#include <sys/wait.h>

extern char** environ;

namespace {

// Starts `argv` in `cwd` with the test's environment, minus the stand-in's
// variables and `drop`, plus `env`.
pid_t Spawn(const std::vector<std::string>& argv, const std::string& cwd,
            const std::map<std::string, std::string>& env, const std::string& drop = "")
{
    std::vector<std::string> environment;
    for (char** entry = environ; *entry; ++entry) {
        const std::string item = *entry;
        if (item.rfind("VELTRONA_STANDIN_", 0) != 0 &&
            (drop.empty() || item.rfind(drop + "=", 0) != 0))
            environment.push_back(item);
    }
    for (const auto& [name, value] : env)
        environment.push_back(name + "=" + value);

    std::vector<char*> argvPointers, envPointers;
    for (const std::string& s : argv)
        argvPointers.push_back(const_cast<char*>(s.c_str()));
    argvPointers.push_back(nullptr);
    for (std::string& s : environment)
        envPointers.push_back(s.data());
    envPointers.push_back(nullptr);

    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_addchdir_np(&actions, cwd.c_str());
    pid_t pid = -1;
    if (posix_spawn(&pid, VELTRONA_STANDIN_PATH, &actions, nullptr, argvPointers.data(),
                    envPointers.data()) != 0)
        pid = -1;
    posix_spawn_file_actions_destroy(&actions);
    return pid;
}

// The exit status of `pid`, or -1 when it is still running at the deadline.
int ExitStatus(pid_t pid, int timeoutMs = 10000)
{
    int status = 0;
    if (!WaitFor([&] { return waitpid(pid, &status, WNOHANG) == pid; }, timeoutMs)) {
        kill(pid, SIGKILL);
        waitpid(pid, nullptr, 0);
        return -1;
    }
    return WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
}

std::string StringProperty(Display* display, Window window, const char* name)
{
    Atom type = None;
    int format = 0;
    unsigned long count = 0, remaining = 0;
    unsigned char* data = nullptr;
    std::string value;
    if (XGetWindowProperty(display, window, XInternAtom(display, name, False), 0, 1024, False,
                           AnyPropertyType, &type, &format, &count, &remaining, &data) == Success &&
        data && format == 8)
        value.assign(reinterpret_cast<char*>(data), count);
    if (data)
        XFree(data);
    return value;
}

TEST(StandinTest, RecordRoundTripsAwkwardArguments)
{
    StandinDir install({"Monitor/Zel Display Studio.exe"});
    StandinDir workDir({});
    const std::string log = install.Path() + "/starts.log";
    const std::string exe = install.Path() + "/Monitor/Zel Display Studio.exe";
    const std::vector<std::string> args = {"two words",   "",
                                           "\"quoted\"",  "it's",
                                           "tab\there",   "line\nbreak",
                                           "back\\slash", "\\n not a newline",
                                           "trailing\\",  "\\t\t\\\n",
                                           " ",           "ünïcode €"};

    std::vector<std::string> argv = {exe};
    argv.insert(argv.end(), args.begin(), args.end());
    const std::map<std::string, std::string> env = {{"VELTRONA_STANDIN_LOG", log},
                                                    {"VELTRONA_STANDIN_EXIT", "1"}};
    const pid_t withArgs = Spawn(argv, workDir.Path(), env);
    ASSERT_GT(withArgs, 0);
    EXPECT_EQ(ExitStatus(withArgs), 0);
    const pid_t bare = Spawn({exe}, install.Path(), env);
    ASSERT_GT(bare, 0);
    EXPECT_EQ(ExitStatus(bare), 0);

    // The file format itself, which other readers parse too.
    const pid_t small = Spawn({exe, "a\tb", "c\\d\ne"}, install.Path(), env);
    ASSERT_GT(small, 0);
    EXPECT_EQ(ExitStatus(small), 0);
    std::stringstream text;
    text << std::ifstream(log).rdbuf();
    const std::string expected = "exe\t" + exe + "\npid\t" + std::to_string(small) + "\ncwd\t" +
                                 install.Path() + "\narg\ta\\tb\narg\tc\\\\d\\ne\nend\n";
    ASSERT_GE(text.str().size(), expected.size());
    EXPECT_EQ(text.str().substr(text.str().size() - expected.size()), expected);

    const auto records = ReadRecords(log);
    ASSERT_EQ(records.size(), 3u);
    EXPECT_EQ(records[0].exe, exe);
    EXPECT_EQ(records[0].pid, withArgs);
    EXPECT_EQ(records[0].cwd, workDir.Path());
    EXPECT_EQ(records[0].args, args);
    EXPECT_EQ(records[1].pid, bare);
    EXPECT_EQ(records[1].cwd, install.Path());
    EXPECT_TRUE(records[1].args.empty());
}

TEST(StandinTest, SimultaneousStartsKeepTheirRecordsWhole)
{
    StandinDir install({"Quenta Edit Studio.exe"});
    const std::string log = install.Path() + "/starts.log";
    const std::string exe = install.Path() + "/Quenta Edit Studio.exe";
    // Long records, so that interleaved writes could not go unnoticed.
    std::map<pid_t, std::string> started;
    for (char c = 'a'; c < 'a' + 16; ++c) {
        const std::string arg(20000, c);
        const pid_t pid = Spawn({exe, arg, "\n"}, install.Path(),
                                {{"VELTRONA_STANDIN_LOG", log}, {"VELTRONA_STANDIN_EXIT", "1"}});
        ASSERT_GT(pid, 0);
        started[pid] = arg;
    }
    for (const auto& entry : started)
        EXPECT_EQ(ExitStatus(entry.first), 0);

    const auto records = WaitForRecords(log, started.size());
    ASSERT_EQ(records.size(), started.size());
    for (const StandinRecord& record : records) {
        ASSERT_EQ(started.count(record.pid), 1u);
        EXPECT_EQ(record.args, (std::vector<std::string>{started[record.pid], "\n"}));
        started.erase(record.pid);
    }
}

TEST(StandinTest, WithoutADisplayItRecordsAndFails)
{
    StandinDir install({"Quenta Print Studio.exe"});
    const std::string log = install.Path() + "/starts.log";
    const pid_t pid = Spawn({install.Path() + "/Quenta Print Studio.exe", "x"}, install.Path(),
                            {{"VELTRONA_STANDIN_LOG", log}}, "DISPLAY");
    ASSERT_GT(pid, 0);
    EXPECT_EQ(ExitStatus(pid), 1);
    const auto records = ReadRecords(log);
    ASSERT_EQ(records.size(), 1u);
    EXPECT_EQ(records[0].args, std::vector<std::string>{"x"});
}

TEST(StandinTest, WindowPassesForTheModuleAndCloses)
{
    const struct
    {
        std::string name, wmClass, title;
    } cases[] = {
        {"ZelVerifyStudio.exe", "TFrm_Main", "Zel Verify Studio"},
        {"Quenta Link Studio.exe", "VeltronaStandin", "Quenta Link Studio.exe"},
    };
    X11Client x11;
    Display* display = XOpenDisplay(nullptr);
    ASSERT_TRUE(display && x11.IsOpen());
    for (const auto& c : cases) {
        StandinDir install({c.name});
        const std::string ready = install.Path() + "/ready";
        const pid_t pid = Spawn({install.Path() + "/" + c.name, "VLT", "1033"}, install.Path(),
                                {{"VELTRONA_STANDIN_READY", ready}});
        ASSERT_GT(pid, 0);
        ASSERT_TRUE(WaitFor([&] { return std::ifstream(ready).good(); })) << c.name;
        unsigned long id = 0;
        std::ifstream(ready) >> id;
        const Window window = id;
        ASSERT_NE(window, 0u);

        XClassHint hint{};
        ASSERT_TRUE(XGetClassHint(display, window, &hint));
        EXPECT_EQ(std::string(hint.res_class), c.wmClass);
        XFree(hint.res_name);
        XFree(hint.res_class);
        EXPECT_EQ(StringProperty(display, window, "_NET_WM_NAME"), c.title);
        EXPECT_EQ(StringProperty(display, window, "WM_NAME"), c.title);
        EXPECT_TRUE(WaitFor([&] { return x11.FindByTitle(c.title) == window; })) << c.name;

        x11.RequestClose(window);
        EXPECT_EQ(ExitStatus(pid), 0) << c.name;
    }
    XCloseDisplay(display);
}

} // namespace
