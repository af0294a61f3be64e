// Icon group and icon image resources: the directory of a group, and one image
// decoded to RGBA (bitmap images) or handed on as PNG bytes. All reads are bounds-checked.
#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

// One image of an icon group, as the group's directory describes it.
struct IconGroupEntry
{
    std::uint8_t width = 0; // 0 means 256
    std::uint8_t height = 0;
    std::uint8_t colourCount = 0;
    std::uint16_t planes = 0;
    std::uint16_t bitCount = 0;
    std::uint32_t bytes = 0;
    std::uint16_t id = 0; // number of the icon resource
};

// The entries of an icon group resource; entries past its end are dropped, and a
// group whose header is not an icon group has none.
std::vector<IconGroupEntry> ParseIconGroup(const unsigned char* data, std::size_t size);

struct IconImage
{
    enum class Kind
    {
        Invalid,
        Pixels,
        Png
    };
    Kind kind = Kind::Invalid;
    int width = 0; // Png: as its header declares
    int height = 0;
    std::vector<unsigned char> rgba;    // Pixels: width * height * 4, top row first
    const unsigned char* png = nullptr; // Png: the stored bytes
    std::size_t pngSize = 0;
};

// Decodes an icon image resource: a device-independent bitmap (1, 4, 8, 24 or 32 bits,
// uncompressed, twice the height for colour and mask) or a PNG file; either is refused
// when it is larger than 1024 pixels a side.
IconImage DecodeIconImage(const unsigned char* data, std::size_t size);
