#include "platform/VersionResource.h"

#include "platform/LittleEndian.h"
#include "platform/ResourceImage.h"

namespace {

const std::size_t fixedInfoSize = 52;
const std::uint32_t fixedInfoSignature = 0xFEEF04BDu;

bool CopyVersionBlock(const ResourceImage& image, std::vector<unsigned char>& block)
{
    const ResourceEntry* entry = image.Find(ResourceTypeVersion, kVersionResourceName);
    if (!entry)
        return false;
    const std::size_t size = entry->size < kMaxVersionBlock ? entry->size : kMaxVersionBlock;
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

VersionResourceResult ReadVersionResource(const ResourceImage& image,
                                          std::vector<unsigned char>& block,
                                          std::size_t& fixedInfoOffset)
{
    block.clear();
    if (!CopyVersionBlock(image, block))
        return VersionResourceResult::Missing;
    return FindFixedFileInfo(block, fixedInfoOffset) ? VersionResourceResult::Found
                                                     : VersionResourceResult::Malformed;
}
