#include "platform/UserLanguage.h"

#include <wx/utils.h>

namespace {

struct Decision
{
    wxLanguage language = wxLANGUAGE_UNKNOWN;
    wxString name;
    bool installed = false;
};

bool g_decided = false;
Decision g_decision;

// "de_AT" from "de_AT.UTF-8@euro"; empty for none, for the C locale and for
// anything that is not a plain language name (it ends up in file names).
wxString LanguageOfEnvironment()
{
    for (const char* variable : {"LC_ALL", "LC_MESSAGES", "LANG"}) {
        wxString value;
        if (!wxGetEnv(variable, &value) || value.empty())
            continue;
        value = value.BeforeFirst('.').BeforeFirst('@');
        if (value.length() < 2 || value.length() > 16 || !wxIsalpha(value[0]) ||
            !wxIsalpha(value[1]))
            return wxString();
        for (const wxUniChar c : value)
            if (!(c.IsAscii() && (wxIsalnum(c) || c == '_')))
                return wxString();
        return value == "C" || value == "POSIX" ? wxString() : value;
    }
    return wxString();
}

Decision Decide()
{
    Decision decision;
    const int system = wxLocale::GetSystemLanguage();
    if (system != wxLANGUAGE_UNKNOWN && system != wxLANGUAGE_DEFAULT) {
        decision.language = static_cast<wxLanguage>(system);
        decision.name = wxLocale::GetLanguageCanonicalName(system);
        decision.installed = true;
        return decision;
    }

    // The toolkit knows only installed locales; the name itself still says
    // which language the user reads.
    decision.name = LanguageOfEnvironment();
    if (decision.name.empty())
        return decision;
    const wxString code = decision.name.BeforeFirst('_');
    const wxLanguageInfo* info = wxLocale::FindLanguageInfo(decision.name);
    if (!info || info->CanonicalName != decision.name)
        info = wxLocale::FindLanguageInfo(code);
    if (info && info->CanonicalName.BeforeFirst('_') == code)
        decision.language = static_cast<wxLanguage>(info->Language);
    else
        decision.name.clear();
    return decision;
}

const Decision& Current()
{
    static Decision fresh;
    if (g_decided)
        return g_decision;
    fresh = Decide();
    return fresh;
}

} // namespace

void DecideUserLanguage()
{
    g_decision = Decide();
    g_decided = true;
}

wxLanguage GetUserLanguage()
{
    return Current().language;
}

wxString GetUserLanguageName()
{
    return Current().name;
}

bool IsUserLocaleInstalled()
{
    return Current().installed;
}
