// libFuzzer target: arbitrary bytes as an executable (ELF or PE, for its resources and its
// version resource), as a resource image and, through its entries, as icon groups, icon
// images and catalogues. What the checks accept goes on to the toolkit's own readers, the
// way the program uses them: catalogues to its .mo parser, icon images to decoding.
#include "platform/IconResource.h"
#include "platform/ResourceImage.h"
#include "platform/VersionResource.h"
#include "resources/CatalogFormat.h"
#include "resources/IconBundle.h"

#include <wx/init.h>
#include <wx/log.h>
#include <wx/translation.h>

namespace {

void ReadAsCatalogue(const unsigned char* data, std::size_t size)
{
    if (!IsWellFormedCatalog(data, size))
        return;
    const wxScopedCharBuffer bytes =
        wxScopedCharBuffer::CreateNonOwned(reinterpret_cast<const char*>(data), size);
    delete wxMsgCatalog::CreateFromData(bytes, "Veltro");
}

} // namespace

extern "C" int LLVMFuzzerInitialize(int*, char***)
{
    wxInitialize();
    wxLog::EnableLogging(false);
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const MemoryByteSource source(data, size);
    std::vector<unsigned char> section;
    ReadElfSection(source, ".rsrc", section);
    std::size_t fixedInfo = 0;
    ReadVersionResource(source, section, fixedInfo);
    FindFixedFileInfo(std::vector<unsigned char>(data, data + size), fixedInfo);
    const ResourceImage image(std::vector<unsigned char>(data, data + size));
    for (const ResourceEntry& entry : image.Entries()) {
        if (entry.type.numeric && entry.type.id == ResourceTypeGroupIcon)
            for (const IconGroupEntry& icon : ParseIconGroup(entry.data, entry.size))
                if (const ResourceEntry* found = image.Find(ResourceTypeIcon, icon.id))
                    DecodeIconResourceImage(found->data, found->size);
        DecodeIconResourceImage(entry.data, entry.size);
        ReadAsCatalogue(entry.data, entry.size);
    }
    // The whole input as one catalogue and one icon image too, so seeds can be small.
    ReadAsCatalogue(data, size);
    DecodeIconResourceImage(data, size);
    return 0;
}
