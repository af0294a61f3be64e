#include "frame/Veltro3MainAppStandardView.h"

#include <wx/intl.h>

namespace {

bool InFamily(const wxString& canonicalName, const char* family)
{
    return canonicalName == family || canonicalName.StartsWith(wxString(family) + "_");
}

} // namespace

int GetModuleLanguageId()
{
    const wxLocale* locale = wxGetLocale();
    const int language = locale ? locale->GetLanguage() : int(wxLANGUAGE_UNKNOWN);
    const wxString name =
        language > wxLANGUAGE_UNKNOWN ? wxLocale::GetLanguageCanonicalName(language) : wxString();

    if (language == wxLANGUAGE_ENGLISH_UK)
        return 0x0809;
    if (InFamily(name, "en"))
        return 0x0409;
    if (InFamily(name, "fr"))
        return 0x040C;
    if (language == wxLANGUAGE_ITALIAN || language == wxLANGUAGE_ITALIAN_SWISS)
        return 0x0410;
    if (InFamily(name, "de"))
        return 0x0407;
    if (InFamily(name, "es"))
        return 0x040A;
    if (InFamily(name, "nl"))
        return 0x0413;
    if (language == wxLANGUAGE_PORTUGUESE_BRAZILIAN)
        return 0x0416;
    if (language == wxLANGUAGE_JAPANESE)
        return 0x0411;
    if (language == wxLANGUAGE_CHINESE_SIMPLIFIED)
        return 0x0804;
    return 0x0409;
}
