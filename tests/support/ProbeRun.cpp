#include "support/ProbeRun.h"

#include "support/GuiWait.h"
#include "support/StandinLog.h"

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <spawn.h>
#include <sstream>
#include <sys/wait.h>
#include <unistd.h>

extern char** environ;

namespace {

int g_probeCount = 0;

} // namespace

ProbeRun::ProbeRun(const std::string& installDir, const std::vector<std::string>& args,
                   const EnvList& env)
{
    namespace fs = std::filesystem;
    const fs::path launcher = fs::path(installDir) / "Veltrona.exe";
    std::error_code ignored;
    if (!fs::exists(launcher))
        fs::create_symlink(VELTRONA_PROBE_PATH, launcher, ignored);

    m_log = installDir + "/probe-" + std::to_string(getpid()) + "-" +
            std::to_string(++g_probeCount) + ".log";

    std::vector<std::string> environment;
    for (char** entry = environ; *entry; ++entry) {
        const std::string item = *entry;
        bool replaced = item.rfind("VELTRONA_PROBE_LOG=", 0) == 0;
        for (const auto& [name, value] : env)
            replaced = replaced || item.rfind(name + "=", 0) == 0;
        if (!replaced)
            environment.push_back(item);
    }
    environment.push_back("VELTRONA_PROBE_LOG=" + m_log);
    for (const auto& [name, value] : env)
        environment.push_back(name + "=" + value);

    std::vector<std::string> argvStrings = {launcher.string()};
    argvStrings.insert(argvStrings.end(), args.begin(), args.end());
    std::vector<char*> argvPointers, envPointers;
    for (std::string& s : argvStrings)
        argvPointers.push_back(s.data());
    argvPointers.push_back(nullptr);
    for (std::string& s : environment)
        envPointers.push_back(s.data());
    envPointers.push_back(nullptr);

    if (posix_spawn(&m_pid, argvPointers[0], nullptr, nullptr, argvPointers.data(),
                    envPointers.data()) != 0)
        m_pid = -1;
}

ProbeRun::~ProbeRun()
{
    if (m_pid > 0 && !m_reaped) {
        kill(m_pid, SIGKILL);
        waitpid(m_pid, nullptr, 0);
    }
    std::remove(m_log.c_str());
}

std::vector<ProbeEvent> ReadEventLog(const std::string& path)
{
    std::vector<ProbeEvent> events;
    std::ifstream in(path);
    std::string line;
    while (std::getline(in, line)) {
        ProbeEvent event;
        std::stringstream fields(line);
        std::string field;
        std::getline(fields, event.kind, '\t');
        while (std::getline(fields, field, '\t'))
            event.fields.push_back(UnescapeField(field));
        events.push_back(event);
    }
    return events;
}

std::vector<ProbeEvent> ProbeRun::Events() const
{
    return ReadEventLog(m_log);
}

std::vector<ProbeEvent> ProbeRun::Events(const std::string& kind) const
{
    std::vector<ProbeEvent> matching;
    for (const ProbeEvent& event : Events())
        if (event.kind == kind)
            matching.push_back(event);
    return matching;
}

bool ProbeRun::WaitForShown(int timeoutMs) const
{
    return WaitFor([this] { return !Events("shown").empty(); }, timeoutMs);
}

bool ProbeRun::WaitForExit(int timeoutMs, int& status)
{
    if (m_pid <= 0 || m_reaped)
        return false;
    m_reaped =
        WaitFor([this, &status] { return waitpid(m_pid, &status, WNOHANG) == m_pid; }, timeoutMs);
    return m_reaped;
}

void ProbeRun::Kill(int signal)
{
    if (m_pid > 0 && !m_reaped)
        kill(m_pid, signal);
}
