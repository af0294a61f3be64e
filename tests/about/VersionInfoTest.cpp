// The version reader over real PE files linked by the mingw tools and ELF files carrying
// compiled resources.
#include "about/VersionInfo.h"

#include <gtest/gtest.h>

#include <stdexcept>

namespace {

const std::string kNotFound = "VersionInfo: can not find the file.";

// The formatted product version, or the message of the error thrown.
std::string Read(const std::string& path)
{
    try {
        return VersionInfo(path).FormatVersion().utf8_string();
    } catch (const std::runtime_error& error) {
        return error.what();
    }
}

} // namespace

TEST(VersionInfo, ReadsTheProductVersionNotTheFileVersion)
{
    // The file versions are 9.8.7.6, 3.0.21.10 and 1.2.3.4000.
    const std::pair<const char*, std::string> cases[] = {
        {"pe-3.0.21.7", "3.0.21.07"}, {"pe-3.0.21.10", "3.0.21.10"}, {"elf-1.2.3.0", "1.2.3.00"},
        {"pe-no-version", kNotFound}, {"elf-no-version", kNotFound}, {"missing", kNotFound},
    };
    for (const auto& [file, expected] : cases)
        EXPECT_EQ(Read(VELTRONA_VERSION_FILES "/" + std::string(file)), expected) << file;
    EXPECT_EQ(GetLauncherVersion(), "3.1.2.01");
}
