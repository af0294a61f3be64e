// Starting and watching the launcher probe on Windows: CreateProcessW with the
// test's environment, the process handle for its end, its status and its window.
#include "support/ProbeRun.h"

#include "support/GuiWait.h"
#include "support/ScopedEnv.h"

#include <windows.h>

#include <cstdio>
#include <filesystem>

ProbeRun::ProbeRun(const std::string& installDir, const Args& args, const EnvList& env,
                   const ProbeStart& start)
{
    namespace fs = std::filesystem;
    const fs::path launcher = fs::path(installDir) / "Veltrona.exe";
    if (!fs::exists(launcher))
        fs::copy_file(VELTRONA_PROBE_PATH, launcher);
    m_log = ProbeLogPath(installDir);
    EnvList environment = env;
    environment.emplace_back("VELTRONA_PROBE_LOG", m_log);
    const ScopedEnv scoped(environment);

    const std::wstring program =
        wxString::FromUTF8(start.program.empty() ? launcher.string() : start.program)
            .ToStdWstring();
    // Test arguments hold neither quotes nor trailing back slashes: quoting each is enough.
    std::wstring line =
        L"\"" + (start.argv0.empty() ? program : wxString::FromUTF8(start.argv0).ToStdWstring()) +
        L"\"";
    for (const std::string& arg : args)
        line += L" \"" + wxString::FromUTF8(arg).ToStdWstring() + L"\"";
    const std::wstring cwd = wxString::FromUTF8(start.cwd).ToStdWstring();
    STARTUPINFOW startup = {};
    startup.cb = sizeof(startup);
    PROCESS_INFORMATION info = {};
    if (CreateProcessW(program.c_str(), line.data(), nullptr, nullptr, FALSE, 0, nullptr,
                       cwd.empty() ? nullptr : cwd.c_str(), &startup, &info)) {
        CloseHandle(info.hThread);
        m_process = info.hProcess;
        m_pid = pid_t(info.dwProcessId);
    }
}

ProbeRun::~ProbeRun()
{
    if (m_process) {
        if (!m_reaped) {
            TerminateProcess(m_process, 1);
            WaitForSingleObject(m_process, 10000);
        }
        CloseHandle(m_process);
    }
    std::remove(m_log.c_str());
}

unsigned long ProbeRun::Window() const
{
    struct Search
    {
        DWORD pid;
        HWND found;
    } search = {DWORD(m_pid), nullptr};
    WaitFor([&] {
        EnumWindows(
            [](HWND window, LPARAM data) -> BOOL {
                auto* s = reinterpret_cast<Search*>(data);
                DWORD owner = 0;
                wchar_t title[64] = {};
                GetWindowThreadProcessId(window, &owner);
                GetWindowTextW(window, title, 64);
                if (owner == s->pid && IsWindowVisible(window) &&
                    std::wstring(title) == L"Veltrona")
                    s->found = window;
                return s->found == nullptr;
            },
            reinterpret_cast<LPARAM>(&search));
        return search.found != nullptr;
    });
    return static_cast<unsigned long>(reinterpret_cast<uintptr_t>(search.found));
}

bool ProbeRun::WaitForExit(int timeoutMs)
{
    if (m_process && !m_reaped)
        m_reaped = WaitFor([this] { return WaitForSingleObject(m_process, 0) == WAIT_OBJECT_0; },
                           timeoutMs);
    return m_reaped;
}

int ProbeRun::ExitCode(int timeoutMs)
{
    DWORD status = 0;
    if (!WaitForExit(timeoutMs) || !GetExitCodeProcess(m_process, &status))
        return -1;
    return int(status);
}

void ProbeRun::Kill(int signal)
{
    if (m_process && !m_reaped)
        TerminateProcess(m_process, 256 + signal);
}
