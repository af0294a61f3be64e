// Starts the launcher probe as the launcher of an installation directory and
// reads back what it recorded: dialogs and shown windows.
#pragma once

#include <string>
#include <sys/types.h>
#include <utility>
#include <vector>

struct ProbeEvent
{
    std::string kind;                // "dialog" or "shown"
    std::vector<std::string> fields; // dialog: message, caption, style; shown: title, ms
};

// Every line of a log of tab-separated, escaped fields, the first being the kind
// (the probe's log, the help viewer stand-in's log).
std::vector<ProbeEvent> ReadEventLog(const std::string& path);

using EnvList = std::vector<std::pair<std::string, std::string>>;

class ProbeRun
{
public:
    // Runs `<installDir>/Veltrona.exe`, a link to the probe, with `args` and
    // the test's environment plus `env`.
    ProbeRun(const std::string& installDir, const std::vector<std::string>& args,
             const EnvList& env = {});
    ~ProbeRun();
    ProbeRun(const ProbeRun&) = delete;
    ProbeRun& operator=(const ProbeRun&) = delete;

    pid_t Pid() const { return m_pid; }
    std::vector<ProbeEvent> Events() const;
    std::vector<ProbeEvent> Events(const std::string& kind) const;

    bool WaitForShown(int timeoutMs = 20000) const;
    // True once the process has ended; its wait status is in `status`.
    bool WaitForExit(int timeoutMs, int& status);
    void Kill(int signal);

private:
    pid_t m_pid = -1;
    bool m_reaped = false;
    std::string m_log;
};
