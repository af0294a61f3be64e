#include "UpdaterSettings.h"

#include <cstdlib>
#include <fstream>

namespace standin {

namespace {

const char kSettingsPath[] = "/Zelgrave/Zel Updater.conf";

std::string Trim(const std::string& text)
{
    const size_t first = text.find_first_not_of(" \t\r");
    if (first == std::string::npos)
        return std::string();
    return text.substr(first, text.find_last_not_of(" \t\r") - first + 1);
}

// A key of the file's root group, before the first "[group]" line.
std::optional<std::string> RootValue(const std::string& path, const std::string& key)
{
    std::ifstream in(path);
    for (std::string line; std::getline(in, line);) {
        line = Trim(line);
        if (!line.empty() && line[0] == '[')
            break;
        const size_t equals = line.find('=');
        if (equals != std::string::npos && Trim(line.substr(0, equals)) == key)
            return Trim(line.substr(equals + 1));
    }
    return std::nullopt;
}

std::string FirstAbsolute(const char* list, const std::string& fallback)
{
    std::string dirs = list ? list : "";
    for (size_t start = 0; start <= dirs.size();) {
        size_t end = dirs.find(':', start);
        if (end == std::string::npos)
            end = dirs.size();
        if (end > start && dirs[start] == '/')
            return dirs.substr(start, end - start);
        start = end + 1;
    }
    return fallback;
}

} // namespace

std::optional<std::string> FindSilentSetting()
{
    const char* home = std::getenv("HOME");
    const std::string userDir =
        FirstAbsolute(std::getenv("XDG_CONFIG_HOME"), std::string(home ? home : "") + "/.config");
    if (auto value = RootValue(userDir + kSettingsPath, "Silent"))
        return value;
    return RootValue(FirstAbsolute(std::getenv("XDG_CONFIG_DIRS"), "/etc/xdg") + kSettingsPath,
                     "Silent");
}

} // namespace standin
