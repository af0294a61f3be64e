#include "support/WestonServer.h"

#include <chrono>
#include <csignal>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <poll.h>
#include <sstream>
#include <sys/inotify.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>

namespace {

const int kStartTimeoutMs = 20000;
// Weston's log line once XWayland accepts X clients; its DISPLAY follows.
const std::string kXServerLine = "xserver listening on display ";
// The desktop shell starts its client from the running event loop: from then on the
// socket and XWayland answer.
const std::string kRunningLine = "weston-desktop-shell'";

} // namespace

WestonServer::WestonServer(int width, int height, bool xwayland)
{
    char dir[] = "/tmp/weston-test.XXXXXX";
    if (!mkdtemp(dir))
        return;
    m_runtimeDir = dir;
    // XWayland's sockets live where every X server's do; Xvfb makes the folder itself.
    mkdir("/tmp/.X11-unix", 01777);
    chmod("/tmp/.X11-unix", 01777);

    // Weston tells XWayland's DISPLAY to its own clients' environment and to its log only:
    // the log is read at each change until the line is there.
    const std::string log = m_runtimeDir + "/weston.log";
    const int watch = inotify_init1(IN_CLOEXEC);
    inotify_add_watch(watch, dir, IN_CREATE | IN_MODIFY);
    const std::string options[] = {"--width=" + std::to_string(width),
                                   "--height=" + std::to_string(height), "--log=" + log,
                                   std::string("--socket=") + Socket()};
    // The child of a threaded process may only exec: its environment is made here.
    const std::string runtime = "XDG_RUNTIME_DIR=" + m_runtimeDir;
    std::vector<const char*> envp{runtime.c_str()};
    for (char** var = environ; *var; ++var)
        if (std::strncmp(*var, "XDG_RUNTIME_DIR=", 16) != 0)
            envp.push_back(*var);
    envp.push_back(nullptr);
    std::vector<const char*> argv = {"weston", "--backend=headless-backend.so", "--no-config"};
    for (const std::string& option : options)
        argv.push_back(option.c_str());
    argv.insert(argv.end(), {xwayland ? "--xwayland" : nullptr, nullptr});
    m_pid = fork();
    if (m_pid == 0) {
        execvpe("weston", const_cast<char**>(argv.data()), const_cast<char**>(envp.data()));
        _exit(127);
    }

    const auto deadline =
        std::chrono::steady_clock::now() + std::chrono::milliseconds(kStartTimeoutMs);
    while (m_pid > 0) {
        std::stringstream text;
        text << std::ifstream(log).rdbuf();
        const std::string content = text.str();
        if (content.find(kRunningLine) != std::string::npos) {
            const size_t at = content.find(kXServerLine);
            if (at != std::string::npos)
                m_display = content.substr(at + kXServerLine.size(),
                                           content.find('\n', at) - at - kXServerLine.size());
            m_ready = !xwayland || !m_display.empty();
            break;
        }
        const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(
            deadline - std::chrono::steady_clock::now());
        pollfd changed = {watch, POLLIN, 0};
        if (waitpid(m_pid, nullptr, WNOHANG) != 0)
            m_pid = -1;
        else if (left.count() <= 0 || poll(&changed, 1, int(left.count())) <= 0)
            break;
        char events[4096];
        (void)!read(watch, events, sizeof events);
    }
    close(watch);
}

WestonServer::~WestonServer()
{
    if (m_pid > 0) {
        kill(m_pid, SIGTERM);
        waitpid(m_pid, nullptr, 0);
    }
    if (!m_runtimeDir.empty())
        std::filesystem::remove_all(m_runtimeDir);
}
