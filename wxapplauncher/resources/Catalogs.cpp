#include "resources/Catalogs.h"

#include "platform/ResourceImage.h"
#include "platform/UserLanguage.h"
#include "resources/CatalogFormat.h"
#include "resources/MemoryTranslationsLoader.h"

#include <wx/filesys.h>
#include <wx/fs_mem.h>
#include <wx/translation.h>

#include <memory>

void LoadCatalogResources()
{
    LoadCatalogResources(ResourceImage::OfExecutable());
}

void LoadCatalogResources(const ResourceImage& image)
{
    for (const std::string& name : image.Names(ResourceTypeRcData))
        LoadCatalogResource(image, wxString::FromUTF8(name.c_str()));
}

wxString CatalogMemoryName(const wxString& resourceName)
{
    wxString name = resourceName;
    if (name.Replace("VELTRO.MO", "Veltro.mo") != 1)
        return wxString();
    const size_t slash = name.find('/');
    if (slash == wxString::npos || slash == 0)
        return wxString();
    const size_t underscore = name.find('_');
    const size_t languageEnd =
        underscore != wxString::npos && underscore > 0 && underscore < slash ? underscore : slash;
    return "./" + name.Left(languageEnd).Lower() + name.Mid(languageEnd);
}

bool LoadCatalogResource(const ResourceImage& image, const wxString& resourceName)
{
    const wxString memoryName = CatalogMemoryName(resourceName);
    if (memoryName.empty())
        return true;
    const ResourceEntry* entry =
        image.Find(ResourceTypeRcData, std::string(resourceName.utf8_str()));
    if (!entry || !IsWellFormedCatalog(entry->data, entry->size))
        return true;
    // The first resource that maps to a name keeps it.
    wxFileSystem fs;
    std::unique_ptr<wxFSFile> existing(fs.OpenFile("memory:" + memoryName));
    if (!existing)
        wxMemoryFSHandler::AddFile(memoryName, entry->data, entry->size);
    return true;
}

void InitLocale(wxLocale& locale)
{
    // Only an installed locale can be set for the C library; the catalogues
    // follow the decided language either way.
    if (IsUserLocaleInstalled())
        locale.Init(GetUserLanguage(), wxLOCALE_LOAD_DEFAULT);

    wxTranslations* translations = wxTranslations::Get();
    if (!translations || !locale.IsOk()) {
        translations = new wxTranslations;
        const wxString name = GetUserLanguageName();
        translations->SetLanguage(name.empty() ? wxString("en") : name);
        wxTranslations::Set(translations);
    }
    translations->SetLoader(new MemoryTranslationsLoader);
}
