#include "StandinRecord.h"

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

} // namespace standin
