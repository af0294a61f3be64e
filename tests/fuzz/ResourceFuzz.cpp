// libFuzzer target: arbitrary bytes as an executable, as a resource image and, through its
// entries, as icon groups, icon images and catalogues. Must never read out of bounds.
#include "platform/IconResource.h"
#include "platform/ResourceImage.h"
#include "resources/CatalogFormat.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    std::vector<unsigned char> section;
    ReadElfSection(MemoryByteSource(data, size), ".rsrc", section);
    const ResourceImage image(std::vector<unsigned char>(data, data + size));
    for (const ResourceEntry& entry : image.Entries()) {
        if (entry.type.numeric && entry.type.id == ResourceTypeGroupIcon)
            for (const IconGroupEntry& icon : ParseIconGroup(entry.data, entry.size))
                if (const ResourceEntry* found = image.Find(ResourceTypeIcon, icon.id))
                    DecodeIconImage(found->data, found->size);
        DecodeIconImage(entry.data, entry.size);
        IsWellFormedCatalog(entry.data, entry.size);
    }
    return 0;
}
