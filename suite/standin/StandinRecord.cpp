#include "StandinRecord.h"

#include <cerrno>
#include <fcntl.h>
#include <unistd.h>

namespace standin {

std::string EscapeField(const std::string& text)
{
    std::string out;
    out.reserve(text.size());
    for (char c : text) {
        switch (c) {
        case '\\':
            out += "\\\\";
            break;
        case '\n':
            out += "\\n";
            break;
        case '\t':
            out += "\\t";
            break;
        default:
            out += c;
        }
    }
    return out;
}

std::string FormatRecord(const std::vector<std::string>& argv, long pid, const std::string& cwd,
                         const std::vector<std::pair<std::string, std::string>>& extra)
{
    std::string record = "exe\t" + EscapeField(argv.empty() ? std::string() : argv.front()) + "\n";
    record += "pid\t" + std::to_string(pid) + "\n";
    record += "cwd\t" + EscapeField(cwd) + "\n";
    for (size_t i = 1; i < argv.size(); ++i)
        record += "arg\t" + EscapeField(argv[i]) + "\n";
    for (const auto& [key, value] : extra)
        record += key + "\t" + EscapeField(value) + "\n";
    record += "end\n";
    return record;
}

std::string CurrentDirectory()
{
    std::string buffer(256, '\0');
    while (getcwd(buffer.data(), buffer.size()) == nullptr) {
        if (errno != ERANGE)
            return std::string();
        buffer.resize(buffer.size() * 2);
    }
    buffer.resize(buffer.find('\0'));
    return buffer;
}

bool AppendRecord(const std::string& path, const std::string& record)
{
    int fd = open(path.c_str(), O_WRONLY | O_APPEND | O_CREAT | O_CLOEXEC, 0644);
    if (fd < 0)
        return false;
    ssize_t written;
    do {
        written = write(fd, record.data(), record.size());
    } while (written < 0 && errno == EINTR);
    bool whole = written == static_cast<ssize_t>(record.size());
    return close(fd) == 0 && whole;
}

} // namespace standin
