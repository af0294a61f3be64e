#include "app/UserLanguage.h"

#include <wx/intl.h>

wxString GetUserLanguageName()
{
    const wxLocale* locale = wxGetLocale();
    if (locale && locale->GetLanguage() > wxLANGUAGE_UNKNOWN)
        return locale->GetCanonicalName();
    return wxString();
}
