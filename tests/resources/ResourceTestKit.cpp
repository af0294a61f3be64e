#include "resources/ResourceTestKit.h"

#include "platform/ResourceImage.h"
#include "resources/Catalogs.h"

#include <wx/filesys.h>
#include <wx/fs_mem.h>

#include <cstdlib>
#include <fstream>
#include <iterator>

namespace {

void Put16(std::vector<unsigned char>& out, std::uint32_t v)
{
    out.push_back(v & 0xFF);
    out.push_back(v >> 8 & 0xFF);
}

void Put32(std::vector<unsigned char>& out, std::uint32_t v)
{
    Put16(out, v & 0xFFFF);
    Put16(out, v >> 16);
}

std::uint32_t Get32(const unsigned char* p)
{
    return std::uint32_t(p[0]) | std::uint32_t(p[1]) << 8 | std::uint32_t(p[2]) << 16 |
           std::uint32_t(p[3]) << 24;
}

void Pad4(std::vector<unsigned char>& out)
{
    while (out.size() % 4)
        out.push_back(0);
}

} // namespace

ResBuilder::ResBuilder()
{
    // The empty entry that opens every image.
    AddEntry(0, {0xFF, 0xFF, 0, 0}, {});
}

ResBuilder& ResBuilder::Add(std::uint16_t type, const std::string& name,
                            const std::vector<unsigned char>& data)
{
    std::vector<unsigned char> field;
    for (char c : name)
        Put16(field, static_cast<unsigned char>(c));
    Put16(field, 0);
    AddEntry(type, field, data);
    return *this;
}

ResBuilder& ResBuilder::Add(std::uint16_t type, std::uint16_t id,
                            const std::vector<unsigned char>& data)
{
    std::vector<unsigned char> field;
    Put16(field, 0xFFFF);
    Put16(field, id);
    AddEntry(type, field, data);
    return *this;
}

void ResBuilder::AddEntry(std::uint16_t type, const std::vector<unsigned char>& nameField,
                          const std::vector<unsigned char>& data)
{
    std::vector<unsigned char> header;
    Put16(header, 0xFFFF);
    Put16(header, type);
    header.insert(header.end(), nameField.begin(), nameField.end());
    while ((header.size() + 8) % 4)
        header.push_back(0);
    Put32(header, 0);      // data version
    Put16(header, 0x1030); // memory flags
    Put16(header, 0x0409); // language
    Put32(header, 0);      // version
    Put32(header, 0);      // characteristics
    Put32(m_bytes, std::uint32_t(data.size()));
    Put32(m_bytes, std::uint32_t(header.size() + 8));
    m_bytes.insert(m_bytes.end(), header.begin(), header.end());
    m_bytes.insert(m_bytes.end(), data.begin(), data.end());
    Pad4(m_bytes);
}

std::map<std::string, std::string> ReadCatalog(const unsigned char* data, std::size_t size)
{
    std::map<std::string, std::string> texts;
    if (size < 28 || Get32(data) != 0x950412DEu)
        return texts;
    const std::uint32_t count = Get32(data + 8);
    const std::uint32_t originals = Get32(data + 12);
    const std::uint32_t translations = Get32(data + 16);
    auto text = [&](std::uint32_t table, std::uint32_t i) {
        const unsigned char* entry = data + table + i * 8;
        return std::string(reinterpret_cast<const char*>(data + Get32(entry + 4)), Get32(entry));
    };
    for (std::uint32_t i = 0; i < count; ++i) {
        const std::string key = text(originals, i);
        if (!key.empty())
            texts[key] = text(translations, i);
    }
    return texts;
}

std::vector<unsigned char> EmbeddedCatalog(const std::string& resourceName)
{
    const ResourceEntry* entry =
        ResourceImage::OfExecutable().Find(ResourceTypeRcData, resourceName);
    if (!entry)
        return {};
    return std::vector<unsigned char>(entry->data, entry->data + entry->size);
}

std::vector<unsigned char> ReadWholeFile(const std::string& path)
{
    std::ifstream in(path, std::ios::binary);
    return std::vector<unsigned char>(std::istreambuf_iterator<char>(in), {});
}

void StartTranslationsLikeLauncher(wxLocale& locale, const char* lang)
{
    for (const char* name : {"LANGUAGE", "LC_ALL", "LC_MESSAGES"})
        unsetenv(name);
    setenv("LANG", lang, 1);
    const wxLanguage language = static_cast<wxLanguage>(wxLocale::GetSystemLanguage());
    // An unknown language trips a toolkit assertion; the launcher shows none.
    const wxAssertHandler_t assertions = wxSetAssertHandler(nullptr);
    locale.Init(language, wxLOCALE_LOAD_DEFAULT);
    wxSetAssertHandler(assertions);
    PrepareTranslations(locale, language);
    wxFileSystem::AddHandler(new wxMemoryFSHandler);
    LoadCatalogResources();
    wxLocale::AddCatalogLookupPathPrefix("memory:.");
    locale.AddCatalog("Veltro");
}
