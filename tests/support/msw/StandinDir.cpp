// Throw-away installations on Windows: a fresh folder, with a blank in its name as in
// "Program Files", holding copies of the stand-in (links need rights users lack there).
#include "support/StandinDir.h"

#include <windows.h>

#include <filesystem>
#include <stdexcept>

namespace fs = std::filesystem;

StandinDir::StandinDir(const std::vector<std::string>& names)
{
    static int made = 0;
    fs::path dir;
    do
        dir = fs::temp_directory_path() /
              ("veltrona install-" + std::to_string(GetCurrentProcessId()) + "-" +
               std::to_string(++made));
    while (!fs::create_directory(dir));
    m_path = fs::canonical(dir).make_preferred().string();
    for (const std::string& name : names) {
        const fs::path copy = (fs::path(m_path) / name).make_preferred();
        fs::create_directories(copy.parent_path());
        fs::copy_file(VELTRONA_STANDIN_PATH, copy);
    }
}
