#include "platform/ResourceImage.h"
#include "platform/VersionResource.h"

#include <wx/string.h>

#include <windows.h>

#include <utility>

// The executable's resources come from the module the system loaded, and
// version resources of other files from the system's version functions.
namespace {

ResourceName NameOf(LPCWSTR name)
{
    ResourceName result;
    if (IS_INTRESOURCE(name)) {
        result.id = static_cast<std::uint16_t>(reinterpret_cast<ULONG_PTR>(name));
        return result;
    }
    result.numeric = false;
    result.text = wxString(name).utf8_string();
    return result;
}

struct Enumeration
{
    HMODULE module;
    LPCWSTR type;
    LPCWSTR name;
    std::vector<ResourceEntry>* entries;
};

// Each language of a resource is an entry of its own, as in a .res image.
BOOL CALLBACK AddLanguage(HMODULE module, LPCWSTR type, LPCWSTR name, WORD language, LONG_PTR param)
{
    auto& entries = *reinterpret_cast<std::vector<ResourceEntry>*>(param);
    HRSRC found = FindResourceExW(module, type, name, language);
    HGLOBAL loaded = found ? LoadResource(module, found) : nullptr;
    const void* data = loaded ? LockResource(loaded) : nullptr;
    if (!data)
        return TRUE;
    // A module's resources stay loaded for as long as the module: nothing is freed.
    ResourceEntry entry;
    entry.type = NameOf(type);
    entry.name = NameOf(name);
    entry.language = language;
    entry.data = static_cast<const unsigned char*>(data);
    entry.size = SizeofResource(module, found);
    entries.push_back(std::move(entry));
    return TRUE;
}

BOOL CALLBACK AddName(HMODULE module, LPCWSTR type, LPWSTR name, LONG_PTR param)
{
    EnumResourceLanguagesW(module, type, name, AddLanguage, param);
    return TRUE;
}

BOOL CALLBACK AddType(HMODULE module, LPWSTR type, LONG_PTR param)
{
    EnumResourceNamesW(module, type, AddName, param);
    return TRUE;
}

} // namespace

const ResourceImage& ResourceImage::OfExecutable()
{
    static const ResourceImage image = [] {
        std::vector<ResourceEntry> entries;
        EnumResourceTypesW(nullptr, AddType, reinterpret_cast<LONG_PTR>(&entries));
        return ResourceImage(std::move(entries));
    }();
    return image;
}

VersionResourceResult ReadVersionResource(const std::string& path,
                                          std::vector<unsigned char>& block,
                                          std::size_t& fixedInfoOffset)
{
    block.clear();
    const wxString file = wxString::FromUTF8(path);
    DWORD ignored = 0;
    const DWORD size = GetFileVersionInfoSizeW(file.wc_str(), &ignored);
    if (size == 0)
        return VersionResourceResult::Missing;
    block.resize(size);
    void* fixed = nullptr;
    UINT fixedSize = 0;
    // The system's reading first; the root block is then checked like any other.
    if (!GetFileVersionInfoW(file.wc_str(), 0, size, block.data()) ||
        !VerQueryValueW(block.data(), L"\\", &fixed, &fixedSize) || !fixed ||
        fixedSize < sizeof(VS_FIXEDFILEINFO))
        return VersionResourceResult::Malformed;
    return FindFixedFileInfo(block, fixedInfoOffset) ? VersionResourceResult::Found
                                                     : VersionResourceResult::Malformed;
}
