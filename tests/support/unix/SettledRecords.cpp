// Settling on Linux: the test's children, read from /proc (the probe makes the
// test the reaper of what the launcher starts, so those count too).
#include "support/StandinLog.h"

#include "support/GuiWait.h"

#include <filesystem>
#include <fstream>
#include <sstream>
#include <unistd.h>

namespace {

// True while a child of this process other than `except` has not ended yet.
bool ChildRunning(pid_t except)
{
    for (const auto& entry : std::filesystem::directory_iterator("/proc")) {
        const std::string name = entry.path().filename();
        if (name.find_first_not_of("0123456789") != std::string::npos ||
            name == std::to_string(except))
            continue;
        std::ifstream stat(entry.path() / "stat");
        std::string line;
        std::getline(stat, line);
        // "pid (command) state ppid ...": the command may hold blanks and parentheses.
        std::istringstream fields(line.substr(line.rfind(')') + 1));
        char state = 0;
        pid_t parent = 0;
        if (fields >> state >> parent && parent == getpid() && state != 'Z')
            return true;
    }
    return false;
}

} // namespace

std::vector<StandinRecord> SettledRecords(const std::string& path, pid_t except, int timeoutMs)
{
    WaitFor([except] { return !ChildRunning(except); }, timeoutMs);
    return ReadRecords(path);
}
