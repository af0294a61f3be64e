// Throw-away installations on Linux: a private directory of links to the stand-in.
#include "support/StandinDir.h"

#include <cstdlib>
#include <filesystem>
#include <stdexcept>

namespace fs = std::filesystem;

StandinDir::StandinDir(const std::vector<std::string>& names)
{
    std::string pattern = (fs::temp_directory_path() / "veltrona-install-XXXXXX").string();
    if (!mkdtemp(pattern.data()))
        throw std::runtime_error("cannot create a directory from " + pattern);
    // Started programs report their real working directory; make Path() match it.
    m_path = fs::canonical(pattern).string();
    for (const std::string& name : names) {
        const fs::path link = fs::path(m_path) / name;
        fs::create_directories(link.parent_path());
        fs::create_symlink(VELTRONA_STANDIN_PATH, link);
    }
}
