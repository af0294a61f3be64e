#include "resources/Catalogs.h"

#include "platform/ResourceImage.h"
#include "resources/CatalogFormat.h"
#include "resources/MemoryTranslationsLoader.h"

#include <wx/filesys.h>
#include <wx/fs_mem.h>
#include <wx/translation.h>
#include <wx/utils.h>

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

namespace {

// The user's language as the environment names it ("de_AT" from "de_AT.UTF-8"), for a
// locale that the system does not have; empty for none or the C locale.
wxString LanguageOfEnvironment()
{
    for (const char* variable : {"LC_ALL", "LC_MESSAGES", "LANG"}) {
        wxString value;
        if (!wxGetEnv(variable, &value) || value.empty())
            continue;
        value = value.BeforeFirst('.').BeforeFirst('@');
        return value == "C" || value == "POSIX" ? wxString() : value;
    }
    return wxString();
}

} // namespace

void PrepareTranslations(wxLocale& locale, wxLanguage language)
{
    wxTranslations* translations = wxTranslations::Get();
    if (!translations || !locale.IsOk()) {
        // The system locale is not installed: without translations of our own the
        // catalogues would never be asked for.
        translations = new wxTranslations;
        if (language != wxLANGUAGE_UNKNOWN && language != wxLANGUAGE_DEFAULT)
            translations->SetLanguage(language);
        else if (!LanguageOfEnvironment().empty())
            translations->SetLanguage(LanguageOfEnvironment());
        wxTranslations::Set(translations);
    }
    translations->SetLoader(new MemoryTranslationsLoader);
}
