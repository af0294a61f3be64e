#include "help/Documentation.h"

#include "help/CAcrobatNotFoundDialog.h"
#include "platform/DesktopOpen.h"
#include "platform/MessageBox.h"
#include "platform/UserLanguage.h"

#include <wx/app.h>
#include <wx/dir.h>
#include <wx/filename.h>
#include <wx/mimetype.h>
#include <wx/stdpaths.h>

#include <memory>

const wxString kUserForumPage = "https://forum.zelgrave.example/forumdisplay.php?f=140";
const wxString kHowToPage = "https://www.zelgrave.example/Quenta/Products/VLT/How%20To/Guides";
const wxString kReaderDownloadPage =
    "https://www.pdfreader-vendor.example/products/acrobat/readstep2.html";

namespace {

const wxString kGuideFolder = "Help/Documentation/";
const wxString kGuideName = "Veltrona.pdf";
const wxString kFallbackLanguage = "en";

wxString GuideLanguage(const wxString& canonicalName)
{
    wxString language = canonicalName.BeforeFirst('_');
    // Chinese guides come in simplified and traditional script.
    if (language == "zh")
        language = canonicalName;
    return language.empty() ? kFallbackLanguage : language;
}

wxString LauncherDir()
{
    return wxFileName(wxStandardPaths::Get().GetExecutablePath())
        .GetPath(wxPATH_GET_VOLUME | wxPATH_GET_SEPARATOR);
}

} // namespace

bool PdfReaderInstalled()
{
    // A manager of its own reads the desktop's MIME database afresh, so a
    // reader installed meanwhile is found.
    wxMimeTypesManager manager;
    std::unique_ptr<wxFileType> type(manager.GetFileTypeFromMimeType("application/pdf"));
    // The shared MIME database knows PDF files even when no program opens them.
    return type && !type->GetOpenCommand(kGuideName).empty();
}

void OpenUserGuide(const wxString& launcherDir, const wxString& language)
{
    wxString folder = GuideLanguage(language);
    if (!wxDir::Exists(launcherDir + kGuideFolder + folder))
        folder = kFallbackLanguage;
    const wxString path = launcherDir + kGuideFolder + folder + wxFILE_SEP_PATH + kGuideName;
    if (wxFileName::FileExists(path))
        OpenWithDesktop(path);
    else
        ShowMessageBox("\"" + path + "\" " + _("not found."), _("Message"), wxOK | wxCENTRE);
}

void OpenUserGuide()
{
    if (!PdfReaderInstalled()) {
        CAcrobatNotFoundDialog dialog(wxTheApp ? wxTheApp->GetTopWindow() : nullptr);
        if (dialog.ShowModal() != wxID_OK || !PdfReaderInstalled())
            return;
    }
    OpenUserGuide(LauncherDir(), GetUserLanguageName());
}

void OpenURL(const wxString& address)
{
    if (address.empty())
        return;
    OpenWithDesktop(address,
                    [] { ShowMessageBox("Failed to open the URL", "Error", wxOK | wxICON_ERROR); });
}

void OpenUserForum()
{
    OpenURL(kUserForumPage);
}

void OpenHowTo()
{
    OpenURL(kHowToPage);
}
