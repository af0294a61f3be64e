#include "support/StandinLog.h"

#include "support/GuiWait.h"

#include <cstdlib>
#include <fstream>

std::string UnescapeField(const std::string& text)
{
    std::string out;
    for (size_t i = 0; i < text.size(); ++i) {
        char c = text[i];
        if (c == '\\' && i + 1 < text.size()) {
            c = text[++i];
            c = c == 'n' ? '\n' : c == 't' ? '\t' : c;
        }
        out += c;
    }
    return out;
}

std::vector<StandinRecord> ReadRecords(const std::string& path)
{
    std::vector<StandinRecord> records;
    StandinRecord record;
    std::ifstream in(path);
    // A record counts once its "end" line is there.
    for (std::string line; std::getline(in, line);) {
        const size_t tab = line.find('\t');
        const std::string key = line.substr(0, tab);
        const std::string value = tab == line.npos ? "" : UnescapeField(line.substr(tab + 1));
        if (key == "exe")
            record = {value, 0, "", {}, std::nullopt};
        else if (key == "pid")
            record.pid = std::atoi(value.c_str());
        else if (key == "cwd")
            record.cwd = value;
        else if (key == "arg")
            record.args.push_back(value);
        else if (key == "silent")
            record.silent = value;
        else if (key == "end")
            records.push_back(record);
    }
    return records;
}

std::vector<StandinRecord> WaitForRecords(const std::string& path, size_t count, int timeoutMs)
{
    std::vector<StandinRecord> records;
    WaitFor([&] { return (records = ReadRecords(path)).size() >= count; }, timeoutMs);
    return records;
}
