#include "support/Reaper.h"

#include <cerrno>
#include <chrono>
#include <csignal>
#include <fstream>
#include <string>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>
#include <vector>

namespace {

pid_t g_tests = 0;

bool BeingTraced()
{
    std::ifstream status("/proc/self/status");
    for (std::string line; std::getline(status, line);)
        if (line.rfind("TracerPid:", 0) == 0)
            return std::stoi(line.substr(10)) != 0;
    return false;
}

// This process's children, zombies included; orphans below the tests come here as well.
std::vector<pid_t> Children()
{
    const std::string self = std::to_string(getpid());
    std::ifstream file("/proc/" + self + "/task/" + self + "/children");
    std::vector<pid_t> children;
    for (pid_t child = 0; file >> child;)
        children.push_back(child);
    return children;
}

// Asks every child left to end and forces those still there after two seconds; a child's
// own orphans come here as it ends, so this goes on until none is left, ten seconds at most.
void EndChildren()
{
    const auto start = std::chrono::steady_clock::now();
    for (auto left = Children(); !left.empty(); left = Children()) {
        const auto waited = std::chrono::steady_clock::now() - start;
        if (waited > std::chrono::seconds(10))
            return;
        for (const pid_t child : left)
            kill(child, waited < std::chrono::seconds(2) ? SIGTERM : SIGKILL);
        std::this_thread::sleep_for(std::chrono::milliseconds(20));
        while (waitpid(-1, nullptr, WNOHANG) > 0) {
        }
    }
}

} // namespace

void RunUnderReaper()
{
    if (BeingTraced())
        return;
    prctl(PR_SET_CHILD_SUBREAPER, 1);
    const pid_t parent = getpid();
    g_tests = fork();
    if (g_tests < 0)
        return;
    if (g_tests == 0) {
        // Killed outright along with the reaper, too.
        prctl(PR_SET_PDEATHSIG, SIGKILL);
        if (getppid() != parent)
            _exit(1);
        return;
    }

    // A stop asked of the reaper is meant for the tests; it ends them and what they left.
    for (const int signal : {SIGINT, SIGTERM, SIGHUP})
        std::signal(signal, [](int received) { kill(g_tests, received); });
    int status = 0;
    while (waitpid(g_tests, &status, 0) < 0 && errno == EINTR) {
    }
    EndChildren();
    if (WIFSIGNALED(status)) {
        std::signal(WTERMSIG(status), SIG_DFL);
        raise(WTERMSIG(status));
    }
    _exit(WIFEXITED(status) ? WEXITSTATUS(status) : 1);
}
