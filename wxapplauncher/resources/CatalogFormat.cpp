#include "resources/CatalogFormat.h"

#include "platform/LittleEndian.h"

#include <cstdint>
#include <cstring>
#include <initializer_list>

namespace {

std::uint32_t Read32(const unsigned char* p, bool bigEndian)
{
    return bigEndian ? Be32(p) : Le32(p);
}

// True when count entries of entrySize bytes at offset lie inside size.
bool TableFits(std::uint64_t offset, std::uint64_t count, std::uint64_t entrySize, std::size_t size)
{
    return offset <= size && count * entrySize <= size - offset;
}

// The toolkit parses a "Plural-Forms" header recursively, one level per operator or
// bracket; real ones are a few dozen bytes long.
const std::size_t maxPluralFormsLength = 256;

// True when the header text (NUL-terminated) names no Plural-Forms, or a short one.
bool PluralFormsAcceptable(const char* header)
{
    const char* plurals = std::strstr(header, "Plural-Forms:");
    if (!plurals)
        return true;
    const char* end = std::strchr(plurals, '\n');
    return !end || std::size_t(end - plurals) <= maxPluralFormsLength;
}

} // namespace

bool IsWellFormedCatalog(const unsigned char* data, std::size_t size)
{
    const std::size_t headerSize = 28;
    if (!data || size <= headerSize)
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
    // The toolkit reads the first entry of both tables even when the count is 0.
    const std::uint64_t entries = count == 0 ? 1 : count;
    if (revision >> 16 > 1 || !TableFits(originals, entries, 8, size) ||
        !TableFits(translations, entries, 8, size) ||
        (hashSize != 0 && !TableFits(hashAt, hashSize, 4, size)))
        return false;
    for (std::uint32_t table : {originals, translations}) {
        for (std::uint64_t i = 0; i < entries; ++i) {
            const unsigned char* entry = data + table + std::size_t(i) * 8;
            const std::uint64_t length = Read32(entry, bigEndian);
            const std::uint64_t offset = Read32(entry + 4, bigEndian);
            // Every string is followed by its terminating NUL.
            if (offset > size || length >= size - offset || data[offset + length] != 0)
                return false;
        }
    }
    // An empty first original marks the header, whose translation the toolkit parses.
    const char* text = reinterpret_cast<const char*>(data);
    const std::uint32_t originalAt = Read32(data + originals + 4, bigEndian);
    const std::uint32_t headerAt = Read32(data + translations + 4, bigEndian);
    return text[originalAt] != 0 || PluralFormsAcceptable(text + headerAt);
}
