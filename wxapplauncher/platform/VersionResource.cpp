#include "platform/VersionResource.h"

#include "platform/LittleEndian.h"
#include "platform/PeResource.h"
#include "platform/ResourceImage.h"

namespace {

// VS_VERSION_INFO is resource 1 of type 16; a version block cannot be longer than
// its 16-bit length field says.
const std::uint16_t versionName = 1;
const std::size_t maxVersionBlock = 0xFFFF;
const std::size_t fixedInfoSize = 52;
const std::uint32_t fixedInfoSignature = 0xFEEF04BDu;

bool ReadFromElf(const ByteSource& source, std::vector<unsigned char>& block)
{
    std::vector<unsigned char> section;
    if (!ReadElfSection(source, ".rsrc", section))
        return false;
    const ResourceImage image(std::move(section));
    const ResourceEntry* entry = image.Find(ResourceTypeVersion, versionName);
    if (!entry)
        return false;
    const std::size_t size = entry->size < maxVersionBlock ? entry->size : maxVersionBlock;
    block.assign(entry->data, entry->data + size);
    return true;
}

} // namespace

bool FindFixedFileInfo(const std::vector<unsigned char>& block, std::size_t& fixedInfoOffset)
{
    // Root block: length, value length, type, the key "VS_VERSION_INFO" in UTF-16 with
    // its terminator, padding to 4 bytes, then the VS_FIXEDFILEINFO as its value.
    static const char key[] = "VS_VERSION_INFO";
    const std::size_t keyAt = 6, keyEnd = keyAt + sizeof key * 2;
    if (block.size() < keyEnd)
        return false;
    const unsigned char* b = block.data();
    const std::size_t length = Le16(b), valueLength = Le16(b + 2);
    if (length < keyEnd || length > block.size())
        return false;
    for (std::size_t i = 0; i < sizeof key; ++i)
        if (Le16(b + keyAt + 2 * i) != std::uint16_t(key[i]))
            return false;
    const std::size_t valueAt = (keyEnd + 3) / 4 * 4;
    if (valueLength < fixedInfoSize || valueAt > length || length - valueAt < fixedInfoSize ||
        Le32(b + valueAt) != fixedInfoSignature)
        return false;
    fixedInfoOffset = valueAt;
    return true;
}

VersionResourceResult ReadVersionResource(const std::string& path,
                                          std::vector<unsigned char>& block,
                                          std::size_t& fixedInfoOffset)
{
    return ReadVersionResource(FileByteSource(path), block, fixedInfoOffset);
}

VersionResourceResult ReadVersionResource(const ByteSource& source,
                                          std::vector<unsigned char>& block,
                                          std::size_t& fixedInfoOffset)
{
    block.clear();
    if (!ReadPeResource(source, ResourceTypeVersion, versionName, maxVersionBlock, block) &&
        !ReadFromElf(source, block))
        return VersionResourceResult::Missing;
    return FindFixedFileInfo(block, fixedInfoOffset) ? VersionResourceResult::Found
                                                     : VersionResourceResult::Malformed;
}
