// Finds the catalogues that start-up copied into the memory file system
// ("memory:./<language>/<domain>.mo"); other catalogues, the toolkit's own among them,
// still come from the file system.
#pragma once

#include <wx/translation.h>

class MemoryTranslationsLoader : public wxTranslationsLoader
{
public:
    // Tries the full language ("pt_BR") first, then its two-letter part ("pt").
    wxMsgCatalog* LoadCatalog(const wxString& domain, const wxString& lang) override;
    wxArrayString GetAvailableTranslations(const wxString& domain) const override;

private:
    wxFileTranslationsLoader m_files;
};
