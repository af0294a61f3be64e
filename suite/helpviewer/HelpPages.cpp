#include "HelpPages.h"

#include <wx/filefn.h>
#include <wx/intl.h>

namespace {

wxString HelpFolder(const wxString& installDir, const wxString& language)
{
    return installDir + "/Documentation/" + language + "/Help/";
}

} // namespace

wxString FindHelpPage(const wxString& installDir, const wxString& applicationId,
                      const wxString& page)
{
    const int system = wxLocale::GetSystemLanguage();
    wxString language =
        system > wxLANGUAGE_UNKNOWN ? wxLocale::GetLanguageCanonicalName(system).Left(2) : "en";
    if (!wxDirExists(HelpFolder(installDir, language)))
        language = "en";
    const wxString folder = HelpFolder(installDir, language);
    const wxString programFolder = applicationId == "LaunchPad" || applicationId.empty()
                                       ? folder
                                       : folder + applicationId + "/";
    if (!page.empty() && wxFileExists(programFolder + page))
        return programFolder + page;
    return folder + "AlternateHelp.html";
}
