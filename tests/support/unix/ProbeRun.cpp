// Starting and watching the launcher probe on Linux: posix_spawn, the test as the
// reaper of what it starts, waitpid and signals.
#include "support/ProbeRun.h"

#include "support/DesktopTools.h"
#include "support/GuiWait.h"
#include "support/ScopedEnv.h"

#include <csignal>
#include <cstdio>
#include <filesystem>
#include <spawn.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

extern char** environ;

ProbeRun::ProbeRun(const std::string& installDir, const Args& args, const EnvList& env,
                   const ProbeStart& start)
{
    namespace fs = std::filesystem;
    const fs::path launcher = fs::path(installDir) / "Veltrona.exe";
    std::error_code failed;
    if (!fs::exists(launcher)) {
        fs::create_hard_link(VELTRONA_PROBE_PATH, launcher, failed);
        if (failed)
            fs::copy_file(VELTRONA_PROBE_PATH, launcher, failed);
    }
    prctl(PR_SET_CHILD_SUBREAPER, 1);

    m_log = ProbeLogPath(installDir);

    EnvList environment = {{"XDG_RUNTIME_DIR", m_log + ".run"}};
    fs::create_directory(environment[0].second);
    environment.insert(environment.end(), env.begin(), env.end());
    environment.emplace_back("VELTRONA_PROBE_LOG", m_log);
    const ScopedEnv scoped(environment);

    const std::string program = start.program.empty() ? launcher.string() : start.program;
    std::vector<std::string> argvStrings = {start.argv0.empty() ? program : start.argv0};
    argvStrings.insert(argvStrings.end(), args.begin(), args.end());
    std::vector<char*> argv;
    for (std::string& s : argvStrings)
        argv.push_back(s.data());
    argv.push_back(nullptr);

    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    if (!start.cwd.empty())
        posix_spawn_file_actions_addchdir_np(&actions, start.cwd.c_str());
    if (posix_spawn(&m_pid, program.c_str(), &actions, nullptr, argv.data(), environ) != 0)
        m_pid = -1;
    posix_spawn_file_actions_destroy(&actions);
}

ProbeRun::~ProbeRun()
{
    if (m_pid > 0 && !m_reaped) {
        kill(m_pid, SIGKILL);
        waitpid(m_pid, nullptr, 0);
    }
    std::remove(m_log.c_str());
}

unsigned long ProbeRun::Window() const
{
    unsigned long window = 0;
    WaitFor([&] { return (window = WindowOf(m_pid, "Veltrona")) != 0; });
    return window;
}

bool ProbeRun::WaitForExit(int timeoutMs)
{
    if (m_pid > 0 && !m_reaped)
        m_reaped =
            WaitFor([this] { return waitpid(m_pid, &m_status, WNOHANG) == m_pid; }, timeoutMs);
    return m_reaped;
}

int ProbeRun::ExitCode(int timeoutMs)
{
    if (!WaitForExit(timeoutMs))
        return -1;
    return WIFEXITED(m_status) ? WEXITSTATUS(m_status) : 256 + WTERMSIG(m_status);
}

void ProbeRun::Kill(int signal)
{
    if (m_pid > 0 && !m_reaped)
        kill(m_pid, signal);
}
