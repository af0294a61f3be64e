// A throw-away installation directory for tests: links to the module stand-in
// under the names the launcher looks for, removed with everything in it.
#pragma once

#include <string>
#include <vector>

class StandinDir
{
public:
    // Names may hold sub-folders ("Monitor/Zel Display Studio.exe").
    explicit StandinDir(const std::vector<std::string>& names);
    ~StandinDir();
    StandinDir(const StandinDir&) = delete;
    StandinDir& operator=(const StandinDir&) = delete;

    // The directory's canonical path, as a started program sees it.
    const std::string& Path() const { return m_path; }
    // Writes a file at `name` below the directory, making its folders; returns its path.
    std::string Write(const std::string& name, const std::string& text) const;

private:
    std::string m_path;
};
