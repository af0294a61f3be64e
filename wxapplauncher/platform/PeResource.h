// Reading one resource from a Windows executable (PE32 or PE32+) in place: the
// resource directory's offsets and sizes are checked against the file at every step.
#pragma once

#include "platform/ResourceImage.h"

#include <cstddef>
#include <cstdint>
#include <vector>

// The data of the resource of the given type and numeric name, in its first language,
// at most maxSize bytes of it; false when the file is no PE file, lacks the resource or
// is malformed.
bool ReadPeResource(const ByteSource& source, std::uint16_t type, std::uint16_t name,
                    std::size_t maxSize, std::vector<unsigned char>& data);
