#include "platform/IconResource.h"

#include "platform/LittleEndian.h"

#include <cstring>

namespace {

// Larger icons than this are not icons; the limit also bounds the memory asked for.
const std::int32_t maxIconSide = 1024;

} // namespace

std::vector<IconGroupEntry> ParseIconGroup(const unsigned char* data, std::size_t size)
{
    std::vector<IconGroupEntry> entries;
    if (!data || size < 6 || Le16(data) != 0 || Le16(data + 2) != 1)
        return entries;
    const std::size_t count = Le16(data + 4);
    for (std::size_t i = 0; i < count && (size - 6) / 14 > i; ++i) {
        const unsigned char* p = data + 6 + i * 14;
        IconGroupEntry e;
        e.width = p[0];
        e.height = p[1];
        e.colourCount = p[2];
        e.planes = Le16(p + 4);
        e.bitCount = Le16(p + 6);
        e.bytes = Le32(p + 8);
        e.id = Le16(p + 12);
        entries.push_back(e);
    }
    return entries;
}

IconImage DecodeIconImage(const unsigned char* data, std::size_t size)
{
    IconImage image;
    static const unsigned char pngSignature[8] = {0x89, 'P', 'N', 'G', '\r', '\n', 0x1A, '\n'};
    if (!data)
        return image;
    if (size >= 8 && std::memcmp(data, pngSignature, 8) == 0) {
        // The first chunk is the header with the size, big-endian, as the PNG format has it.
        if (size < 24 || std::memcmp(data + 12, "IHDR", 4) != 0)
            return image;
        const std::uint32_t width = Be32(data + 16), height = Be32(data + 20);
        if (width == 0 || width > maxIconSide || height == 0 || height > maxIconSide)
            return image;
        image.width = int(width);
        image.height = int(height);
        image.kind = IconImage::Kind::Png;
        image.png = data;
        image.pngSize = size;
        return image;
    }
    if (size < 40)
        return image;
    const std::uint32_t headerSize = Le32(data);
    const std::int32_t width = std::int32_t(Le32(data + 4));
    const std::int32_t doubleHeight = std::int32_t(Le32(data + 8));
    const unsigned bits = Le16(data + 14);
    const std::uint32_t compression = Le32(data + 16);
    const std::uint32_t coloursUsed = Le32(data + 32);
    if (headerSize < 40 || headerSize > size || compression != 0 || width <= 0 ||
        width > maxIconSide || doubleHeight <= 0 || doubleHeight > 2 * maxIconSide ||
        doubleHeight % 2 != 0)
        return image;
    if (bits != 1 && bits != 4 && bits != 8 && bits != 24 && bits != 32)
        return image;
    const std::size_t w = std::size_t(width), h = std::size_t(doubleHeight / 2);

    std::size_t paletteSize = 0;
    if (bits <= 8) {
        const std::size_t maxColours = std::size_t(1) << bits;
        paletteSize = coloursUsed == 0 || coloursUsed > maxColours ? maxColours : coloursUsed;
    }
    const std::size_t colourStride = (w * bits + 31) / 32 * 4;
    const std::size_t maskStride = (w + 31) / 32 * 4;
    const std::size_t paletteAt = headerSize;
    const std::size_t colourAt = paletteAt + paletteSize * 4;
    const std::size_t maskAt = colourAt + colourStride * h;
    if (colourAt > size || colourStride * h > size - colourAt)
        return image;
    // A 32-bit image carries its own alpha and may come without a mask.
    const bool hasMask = maskStride * h <= size - maskAt;
    if (!hasMask && bits != 32)
        return image;

    image.width = int(w);
    image.height = int(h);
    image.rgba.assign(w * h * 4, 0);
    bool anyAlpha = false;
    for (std::size_t y = 0; y < h; ++y) {
        // Rows are stored bottom-up.
        const unsigned char* row = data + colourAt + (h - 1 - y) * colourStride;
        unsigned char* out = image.rgba.data() + y * w * 4;
        for (std::size_t x = 0; x < w; ++x, out += 4) {
            if (bits >= 24) {
                const unsigned char* px = row + x * (bits / 8);
                out[0] = px[2];
                out[1] = px[1];
                out[2] = px[0];
                out[3] = bits == 32 ? px[3] : 255;
                anyAlpha = anyAlpha || (bits == 32 && px[3] != 0);
                continue;
            }
            const std::size_t bit = x * bits;
            const unsigned shift = unsigned(8 - bits - bit % 8);
            const std::size_t index = (row[bit / 8] >> shift) & ((1u << bits) - 1);
            if (index < paletteSize) {
                const unsigned char* colour = data + paletteAt + index * 4;
                out[0] = colour[2];
                out[1] = colour[1];
                out[2] = colour[0];
            }
            out[3] = 255;
        }
    }
    // The mask decides transparency unless the image has alpha of its own.
    if (hasMask && !(bits == 32 && anyAlpha)) {
        for (std::size_t y = 0; y < h; ++y) {
            const unsigned char* row = data + maskAt + (h - 1 - y) * maskStride;
            unsigned char* out = image.rgba.data() + y * w * 4;
            for (std::size_t x = 0; x < w; ++x)
                out[x * 4 + 3] = (row[x / 8] >> (7 - x % 8)) & 1 ? 0 : 255;
        }
    }
    image.kind = IconImage::Kind::Pixels;
    return image;
}
