#include "HelpPages.h"

#include <wx/filefn.h>
#include <wx/filename.h>
#include <wx/intl.h>

namespace {

wxString HelpFolder(const wxString& installDir, const wxString& language)
{
    wxFileName folder = wxFileName::DirName(installDir);
    folder.AppendDir("Documentation");
    folder.AppendDir(language);
    folder.AppendDir("Help");
    return folder.GetPath(wxPATH_GET_VOLUME | wxPATH_GET_SEPARATOR);
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
                                       : folder + applicationId + wxFILE_SEP_PATH;
    if (!page.empty() && wxFileExists(programFolder + page))
        return programFolder + page;
    return folder + "AlternateHelp.html";
}
