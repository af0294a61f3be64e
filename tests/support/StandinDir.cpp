#include "support/StandinDir.h"

#include <filesystem>
#include <fstream>

namespace fs = std::filesystem;

std::string StandinDir::Write(const std::string& name, const std::string& text) const
{
    const fs::path path = fs::path(m_path) / name;
    fs::create_directories(path.parent_path());
    std::ofstream(path, std::ios::binary) << text;
    return path.string();
}

StandinDir::~StandinDir()
{
    std::error_code ignored;
    fs::remove_all(m_path, ignored);
}
