// The version reader over real PE files linked by the mingw tools and ELF files carrying
// compiled resources, whole, damaged and cut short.
#include "about/VersionInfo.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdio>
#include <fstream>
#include <iterator>
#include <stdexcept>

namespace {

const std::string kDir = VELTRONA_VERSION_FILES "/";
const std::string kNotFound = "VersionInfo: can not find the file.";
const std::string kNoVersion = "VersionInfo: can not retrieve version information";

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
        EXPECT_EQ(Read(kDir + file), expected) << file;
    EXPECT_EQ(GetLauncherVersion(), "3.1.2.01");
}

TEST(VersionInfo, DamagedFilesAreUnreadableNeverACrash)
{
    const std::string copy = testing::TempDir() + "damaged";
    auto write = [&](const std::vector<char>& bytes, std::size_t length) {
        std::ofstream(copy, std::ios::binary).write(bytes.data(), long(length));
    };
    for (const char* file : {"pe-3.0.21.7", "elf-1.2.3.0"}) {
        std::ifstream in(kDir + file, std::ios::binary);
        std::vector<char> bytes(std::istreambuf_iterator<char>(in), {});
        // Without the fixed info's signature the root block is no version.
        const std::string signature = "\xBD\x04\xEF\xFE";
        auto at = std::search(bytes.begin(), bytes.end(), signature.begin(), signature.end());
        ASSERT_NE(at, bytes.end()) << file;
        *at = 0;
        write(bytes, bytes.size());
        EXPECT_EQ(Read(copy), kNoVersion) << file;
        *at = '\xBD';
        // Cut short anywhere, a file yields its version only while the resource is whole.
        for (std::size_t length = 0; length < bytes.size(); length += 1 + length / 9) {
            write(bytes, length);
            const std::string read = Read(copy);
            EXPECT_TRUE(read == kNotFound || read == kNoVersion || read == Read(kDir + file))
                << file << " cut at " << length << ": " << read;
        }
    }
    std::remove(copy.c_str());
}
