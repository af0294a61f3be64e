// Settling on Windows: every process descended from the test, found through the
// system's process snapshot. A process outlives its parent there without being
// adopted, so every descendant once seen is remembered with its own children.
#include "support/StandinLog.h"

#include "support/GuiWait.h"

#include <windows.h>

#include <tlhelp32.h>

#include <set>

namespace {

bool DescendantRunning(pid_t except)
{
    static std::set<DWORD> family = {GetCurrentProcessId()};
    const HANDLE snapshot = CreateToolhelp32Snapshot(TH32CS_SNAPPROCESS, 0);
    if (snapshot == INVALID_HANDLE_VALUE)
        return false;
    std::set<DWORD> running;
    for (bool grew = true; grew;) {
        grew = false;
        PROCESSENTRY32W entry = {};
        entry.dwSize = sizeof(entry);
        for (BOOL ok = Process32FirstW(snapshot, &entry); ok;
             ok = Process32NextW(snapshot, &entry)) {
            const DWORD pid = entry.th32ProcessID;
            if (pid == GetCurrentProcessId() || !family.count(entry.th32ParentProcessID))
                continue;
            grew |= family.insert(pid).second;
            if (pid != DWORD(except))
                running.insert(pid);
        }
    }
    CloseHandle(snapshot);
    return !running.empty();
}

} // namespace

std::vector<StandinRecord> SettledRecords(const std::string& path, pid_t except, int timeoutMs)
{
    WaitFor([except] { return !DescendantRunning(except); }, timeoutMs);
    return ReadRecords(path);
}
