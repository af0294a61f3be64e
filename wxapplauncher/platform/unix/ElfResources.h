// The Windows resources of Linux executables: the ELF section ".rsrc" that the
// build fills with a .res image, and version resources read from PE or ELF files.
#pragma once

#include "platform/VersionResource.h"

#include <cstddef>
#include <string>
#include <vector>

class ByteSource;

// The contents of the named section of an ELF file (32 or 64 bit, little-endian);
// false when the file is no such ELF file, lacks the section or is malformed.
bool ReadElfSection(const ByteSource& source, const std::string& sectionName,
                    std::vector<unsigned char>& contents);
bool ReadElfSectionOfFile(const std::string& path, const std::string& sectionName,
                          std::vector<unsigned char>& contents);

// The version resource of a PE file's resources or of an ELF file's ".rsrc"
// section, as ReadVersionResource reads it from a path.
VersionResourceResult ReadVersionResource(const ByteSource& source,
                                          std::vector<unsigned char>& block,
                                          std::size_t& fixedInfoOffset);
