// Starts the launcher probe as the launcher of an installation directory and
// reads back what it recorded: dialogs and shown windows.
#pragma once

#include <string>
#include <sys/types.h>
#include <utility>
#include <vector>

struct ProbeEvent
{
    std::string kind; // "dialog", "shown", "placed" or "command"
    // dialog: message, caption, style, controls; shown: title, ms; placed: title,
    // x, y, width, height; command: id, ms
    std::vector<std::string> fields;
};

// A fresh name for a probe's log in the installation directory.
std::string ProbeLogPath(const std::string& installDir);

// Every line of a log of tab-separated, escaped fields, the first being the kind
// (the probe's log, the help viewer stand-in's log).
std::vector<ProbeEvent> ReadEventLog(const std::string& path);

using Args = std::vector<std::string>;
using EnvList = std::vector<std::pair<std::string, std::string>>;

// How the launcher is started, when not by its full path from the test's own working directory.
struct ProbeStart
{
    std::string program; // the file run; default <installDir>/Veltrona.exe
    std::string argv0;   // what it is told its name is; default `program`
    std::string cwd;     // where it starts
};

class ProbeRun
{
public:
    // Runs `<installDir>/Veltrona.exe`, the probe (a hard link, so that the launcher finds
    // itself there), with `args` and the test's environment plus `env`, in an XDG_RUNTIME_DIR
    // of its own unless `env` names one. Stand-ins it starts become children of the test
    // once it ends, so SettledRecords waits for them too.
    ProbeRun(const std::string& installDir, const Args& args, const EnvList& env = {},
             const ProbeStart& start = {});
    ~ProbeRun();
    ProbeRun(const ProbeRun&) = delete;
    ProbeRun& operator=(const ProbeRun&) = delete;

    pid_t Pid() const { return m_pid; }
    std::vector<ProbeEvent> Events() const;
    std::vector<ProbeEvent> Events(const std::string& kind) const;

    // Until the main frame is shown.
    bool WaitForShown(int timeoutMs = 20000) const;
    // Its frame's window (X window, HWND) once visible, 0 if none shows.
    unsigned long Window() const;
    // True once the process has ended.
    bool WaitForExit(int timeoutMs = 10000);
    // Its exit status once it has ended, 256 + the signal that ended it (Windows: the
    // status TerminateProcess gave), -1 if it runs on.
    int ExitCode(int timeoutMs = 10000);
    void Kill(int signal);

private:
    pid_t m_pid = -1;
    bool m_reaped = false;
    int m_status = 0;
    std::string m_log;
    void* m_process = nullptr; // Windows: the process's handle
};
