// Reading little-endian integers from resource and executable images, and the
// big-endian ones that PNG headers and byte-swapped catalogues hold.
#pragma once

#include <cstdint>

inline std::uint16_t Le16(const unsigned char* p)
{
    return std::uint16_t(p[0] | p[1] << 8);
}

inline std::uint32_t Le32(const unsigned char* p)
{
    return std::uint32_t(p[0]) | std::uint32_t(p[1]) << 8 | std::uint32_t(p[2]) << 16 |
           std::uint32_t(p[3]) << 24;
}

inline std::uint64_t Le64(const unsigned char* p)
{
    return std::uint64_t(Le32(p)) | std::uint64_t(Le32(p + 4)) << 32;
}

inline std::uint32_t Be32(const unsigned char* p)
{
    return std::uint32_t(p[0]) << 24 | std::uint32_t(p[1]) << 16 | std::uint32_t(p[2]) << 8 |
           std::uint32_t(p[3]);
}
