#include "resources/MemoryTranslationsLoader.h"

#include "resources/CatalogFormat.h"

#include <wx/filesys.h>
#include <wx/mstream.h>

#include <memory>

namespace {

wxString MemoryPath(const wxString& lang, const wxString& domain)
{
    return "memory:./" + lang + "/" + domain + ".mo";
}

wxMsgCatalog* LoadFromMemory(const wxString& domain, const wxString& lang)
{
    wxFileSystem fs;
    std::unique_ptr<wxFSFile> file(fs.OpenFile(MemoryPath(lang, domain)));
    if (!file || !file->GetStream())
        return nullptr;
    wxMemoryOutputStream bytes;
    bytes.Write(*file->GetStream());
    const size_t size = bytes.GetLength();
    wxCharBuffer data(size);
    bytes.CopyTo(data.data(), size);
    if (!IsWellFormedCatalog(reinterpret_cast<const unsigned char*>(data.data()), size))
        return nullptr;
    return wxMsgCatalog::CreateFromData(data, domain);
}

} // namespace

wxMsgCatalog* MemoryTranslationsLoader::LoadCatalog(const wxString& domain, const wxString& lang)
{
    // The toolkit asks again with the two-letter language ("pt" after "pt_BR").
    if (wxMsgCatalog* catalog = LoadFromMemory(domain, lang))
        return catalog;
    return m_files.LoadCatalog(domain, lang);
}

wxArrayString MemoryTranslationsLoader::GetAvailableTranslations(const wxString& domain) const
{
    wxArrayString langs = m_files.GetAvailableTranslations(domain);
    const wxString prefix = "memory:./";
    const wxString suffix = "/" + domain + ".mo";
    wxFileSystem fs;
    for (wxString found = fs.FindFirst(prefix + "*" + suffix, wxFILE); !found.empty();
         found = fs.FindNext()) {
        wxString lang;
        if (found.StartsWith(prefix, &lang) && lang.EndsWith(suffix, &lang) &&
            !lang.Contains("/") && langs.Index(lang) == wxNOT_FOUND)
            langs.Add(lang);
    }
    return langs;
}
