// The Windows resources of Linux executables: the ELF section ".rsrc" that the
// build fills with a .res image, and version resources read from PE or ELF files.
#pragma once

#include "platform/VersionResource.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

class ByteSource;
class ResourceImage;

// Where the named section of an ELF file (32 or 64 bit, little-endian) lies in it;
// false when the file is no such ELF file, lacks the section or is malformed.
bool FindElfSection(const ByteSource& source, const std::string& sectionName, std::uint64_t& offset,
                    std::uint64_t& size);
// The contents of the named section of an ELF file (32 or 64 bit, little-endian);
// false when the file is no such ELF file, lacks the section or is malformed.
bool ReadElfSection(const ByteSource& source, const std::string& sectionName,
                    std::vector<unsigned char>& contents);
bool ReadElfSectionOfFile(const std::string& path, const std::string& sectionName,
                          std::vector<unsigned char>& contents);

// The resources of an ELF file's ".rsrc" section, mapped, so the file must not
// change while the image lives (a running executable cannot); empty when there are none.
ResourceImage MapElfResources(const std::string& path);

// The version resource of a PE file's resources or of an ELF file's ".rsrc"
// section, as ReadVersionResource reads it from a path.
VersionResourceResult ReadVersionResource(const ByteSource& source,
                                          std::vector<unsigned char>& block,
                                          std::size_t& fixedInfoOffset);
