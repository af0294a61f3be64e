#include "support/StandinLog.h"

#include "support/GuiWait.h"

#include <cstdlib>
#include <fstream>

std::string UnescapeField(const std::string& text)
{
    std::string out;
    out.reserve(text.size());
    for (size_t i = 0; i < text.size(); ++i) {
        if (text[i] != '\\' || i + 1 == text.size()) {
            out += text[i];
            continue;
        }
        const char next = text[++i];
        out += next == 'n' ? '\n' : next == 't' ? '\t' : next;
    }
    return out;
}

std::vector<StandinRecord> ReadRecords(const std::string& path)
{
    std::vector<StandinRecord> records;
    std::ifstream in(path);
    std::string line;
    StandinRecord current;
    // A record counts once its "end" line is there; lines outside a record
    // that began with "exe" are the tail of a damaged one and are skipped.
    bool open = false;
    while (std::getline(in, line)) {
        const size_t tab = line.find('\t');
        const std::string key = line.substr(0, tab);
        const std::string value =
            tab == std::string::npos ? std::string() : UnescapeField(line.substr(tab + 1));
        if (key == "exe") {
            current = StandinRecord();
            current.exe = value;
            open = true;
        } else if (!open) {
            continue;
        } else if (key == "pid") {
            current.pid = static_cast<pid_t>(std::strtol(value.c_str(), nullptr, 10));
        } else if (key == "cwd") {
            current.cwd = value;
        } else if (key == "arg") {
            current.args.push_back(value);
        } else if (key == "end") {
            records.push_back(current);
            open = false;
        }
    }
    return records;
}

std::vector<StandinRecord> WaitForRecords(const std::string& path, size_t count, int timeoutMs)
{
    std::vector<StandinRecord> records;
    WaitFor(
        [&] {
            records = ReadRecords(path);
            return records.size() >= count;
        },
        timeoutMs);
    return records;
}
