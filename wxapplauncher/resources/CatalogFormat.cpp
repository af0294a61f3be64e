#include "resources/CatalogFormat.h"

#include "platform/LittleEndian.h"

#include <cstdint>
#include <initializer_list>

namespace {

std::uint32_t Read32(const unsigned char* p, bool bigEndian)
{
    if (bigEndian)
        return std::uint32_t(p[0]) << 24 | std::uint32_t(p[1]) << 16 | std::uint32_t(p[2]) << 8 |
               std::uint32_t(p[3]);
    return Le32(p);
}

// True when count entries of entrySize bytes at offset lie inside size.
bool TableFits(std::uint64_t offset, std::uint64_t count, std::uint64_t entrySize, std::size_t size)
{
    return offset <= size && count * entrySize <= size - offset;
}

} // namespace

bool IsWellFormedCatalog(const unsigned char* data, std::size_t size)
{
    const std::size_t headerSize = 28;
    if (!data || size < headerSize)
        return false;
    const std::uint32_t magic = Read32(data, false);
    bool bigEndian;
    if (magic == 0x950412DEu)
        bigEndian = false;
    else if (magic == 0xDE120495u)
        bigEndian = true;
    else
        return false;
    const std::uint32_t revision = Read32(data + 4, bigEndian);
    const std::uint32_t count = Read32(data + 8, bigEndian);
    const std::uint32_t originals = Read32(data + 12, bigEndian);
    const std::uint32_t translations = Read32(data + 16, bigEndian);
    const std::uint32_t hashSize = Read32(data + 20, bigEndian);
    const std::uint32_t hashAt = Read32(data + 24, bigEndian);
    if (revision >> 16 > 1 || !TableFits(originals, count, 8, size) ||
        !TableFits(translations, count, 8, size) ||
        (hashSize != 0 && !TableFits(hashAt, hashSize, 4, size)))
        return false;
    for (std::uint32_t table : {originals, translations}) {
        for (std::uint32_t i = 0; i < count; ++i) {
            const unsigned char* entry = data + table + std::size_t(i) * 8;
            const std::uint64_t length = Read32(entry, bigEndian);
            const std::uint64_t offset = Read32(entry + 4, bigEndian);
            // Every string is followed by its terminating NUL.
            if (offset > size || length >= size - offset || data[offset + length] != 0)
                return false;
        }
    }
    return true;
}
