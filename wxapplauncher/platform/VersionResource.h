// The version resource (VS_VERSIONINFO) of an executable, read the way the Windows
// version functions read it. Nothing is trusted: a malformed file is simply
// unreadable.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

// VS_VERSION_INFO is resource 1 of the version type; a version block cannot be
// longer than its 16-bit length field says.
constexpr std::uint16_t kVersionResourceName = 1;
constexpr std::size_t kMaxVersionBlock = 0xFFFF;

enum class VersionResourceResult
{
    Found,
    Missing,  // no file, or a file without a version resource
    Malformed // a version resource without a valid root block
};

// Reads the version resource of the file into block and checks its root block; on
// Found, fixedInfoOffset is where the VS_FIXEDFILEINFO starts (its 52 bytes lie in block).
VersionResourceResult ReadVersionResource(const std::string& path,
                                          std::vector<unsigned char>& block,
                                          std::size_t& fixedInfoOffset);

// The same from resources already read, such as the running executable's.
class ResourceImage;
VersionResourceResult ReadVersionResource(const ResourceImage& image,
                                          std::vector<unsigned char>& block,
                                          std::size_t& fixedInfoOffset);

// Checks the root block of a version resource already in memory.
bool FindFixedFileInfo(const std::vector<unsigned char>& block, std::size_t& fixedInfoOffset);
