// libFuzzer target: arbitrary bytes as an executable (ELF or PE, for its resources and its
// version resource), as a resource image and, through its entries, as icon groups, icon
// images and catalogues. What the checks accept goes on to the toolkit's own readers, the
// way the program uses them: catalogues to its .mo parser, icon images to decoding.
#include "platform/IconResource.h"
#include "platform/ResourceImage.h"
#include "platform/VersionResource.h"
#include "platform/unix/ElfResources.h"
#include "resources/CatalogFormat.h"
#include "resources/IconBundle.h"

#include <wx/init.h>
#include <wx/log.h>
#include <wx/translation.h>

namespace {

// Hands the bytes to the toolkit as the program's loader does; the toolkit's translations
// object owns, and frees, what it parses.
class BytesLoader : public wxTranslationsLoader
{
public:
    BytesLoader(const unsigned char* data, std::size_t size) : m_data(data), m_size(size) {}
    wxMsgCatalog* LoadCatalog(const wxString& domain, const wxString&) override
    {
        return wxMsgCatalog::CreateFromData(
            wxScopedCharBuffer::CreateNonOwned(reinterpret_cast<const char*>(m_data), m_size),
            domain);
    }
    wxArrayString GetAvailableTranslations(const wxString&) const override
    {
        return wxArrayString(1, "de");
    }

private:
    const unsigned char* m_data;
    std::size_t m_size;
};

void ReadAsCatalogue(const unsigned char* data, std::size_t size)
{
    if (!IsWellFormedCatalog(data, size))
        return;
    wxTranslations translations;
    translations.SetLanguage("de");
    translations.SetLoader(new BytesLoader(data, size));
    translations.AddCatalog("Veltro");
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
