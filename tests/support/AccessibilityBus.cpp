#include "support/AccessibilityBus.h"

#include "support/GuiWait.h"

#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <poll.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>

extern char** environ;

namespace {

// Who may do what on the bus; without service files, nothing starts behind the test's back.
const char kRules[] = R"(<type>accessibility</type>
  <auth>EXTERNAL</auth>
  <policy context="default">
    <allow send_destination="*" eavesdrop="true"/>
    <allow eavesdrop="true"/>
    <allow own="*"/>
  </policy>)";

pid_t Start(std::vector<std::string> args, int out = -1)
{
    std::vector<char*> argv;
    for (std::string& arg : args)
        argv.push_back(arg.data());
    argv.push_back(nullptr);
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    if (out >= 0)
        posix_spawn_file_actions_adddup2(&actions, out, STDOUT_FILENO);
    pid_t pid = -1;
    if (posix_spawnp(&pid, argv[0], &actions, nullptr, argv.data(), environ) != 0)
        pid = -1;
    posix_spawn_file_actions_destroy(&actions);
    return pid;
}

// The first line the program writes to `fd`, waiting at most `timeoutMs`.
std::string ReadLine(int fd, int timeoutMs)
{
    std::string line;
    pollfd readable = {fd, POLLIN, 0};
    char c = 0;
    while (poll(&readable, 1, timeoutMs) > 0 && read(fd, &c, 1) == 1 && c != '\n')
        line += c;
    return line;
}

void Stop(pid_t pid)
{
    if (pid <= 0)
        return;
    kill(pid, SIGTERM);
    if (!WaitFor([pid] { return waitpid(pid, nullptr, WNOHANG) == pid; }, 5000)) {
        kill(pid, SIGKILL);
        waitpid(pid, nullptr, 0);
    }
}

} // namespace

AccessibilityBus::AccessibilityBus()
{
    char dir[] = "/tmp/veltrona-a11y-XXXXXX";
    if (!mkdtemp(dir)) {
        m_failure = "no folder for the accessibility bus";
        return;
    }
    m_dir = dir;
    const std::string address = "unix:path=" + m_dir + "/bus";
    const std::string config = m_dir + "/bus.conf";
    std::ofstream(config) << "<busconfig>\n  <listen>" << address << "</listen>\n  " << kRules
                          << "\n</busconfig>\n";

    // The registry finds the bus by this name, as do the test's and its programs' toolkits,
    // whose bridge to the bus is on while it exists.
    m_env.emplace(std::vector<std::pair<std::string, std::string>>{{"AT_SPI_BUS_ADDRESS", address},
                                                                   {"NO_AT_BRIDGE", "0"}});
    int printed[2];
    if (pipe2(printed, O_CLOEXEC) != 0) {
        m_failure = "no pipe for the accessibility bus's address";
        return;
    }
    m_daemon = Start({"dbus-daemon", "--config-file=" + config, "--nofork", "--print-address=1"},
                     printed[1]);
    close(printed[1]);
    const bool listening = !ReadLine(printed[0], 20000).empty();
    close(printed[0]);
    if (!listening) {
        m_failure = "the accessibility bus did not print its address within 20 s";
        return;
    }
    m_registry = Start({ATSPI_REGISTRYD_PATH});
    const std::string wait =
        "gdbus wait --address '" + address + "' --timeout 20 org.a11y.atspi.Registry";
    if (m_registry < 0 || std::system(wait.c_str()) != 0)
        m_failure = "the accessibility registry did not take its name on the bus within 20 s";
}

AccessibilityBus::~AccessibilityBus()
{
    Stop(m_registry);
    Stop(m_daemon);
    if (!m_dir.empty())
        std::filesystem::remove_all(m_dir);
}
