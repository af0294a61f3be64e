#include "help/CHelpToolDlg.h"

#include "help/HelpLanguage.h"
#include "help/HelpToolTextCtrl.h"
#include "platform/UserLanguage.h"

#include <wx/button.h>
#include <wx/filefn.h>
#include <wx/filename.h>
#include <wx/sizer.h>
#include <wx/stattext.h>
#include <wx/stdpaths.h>

namespace {

const char* const kHtml = ".html";
const char* const kAlternatePage = "AlternateHelp.html";
const int kFieldWidth = 450;

// The help sub-folder of each program the suite knows; the launcher and the
// updater keep their pages in the help folder itself.
struct ProgramHelp
{
    const char* appName;
    const char* subFolder;
};

const ProgramHelp kProgramHelp[] = {
    {"Veltrona", ""},
    {"Quenta Link Studio", "LinkStudio"},
    {"Quenta Print Studio", "PrintStudio"},
    {"Quenta Edit Studio", "EditStudio"},
    {"Quenta Inspect Studio", "InspectStudio"},
    {"Veltrona Updater", ""},
};

wxString WithHtml(const wxString& page)
{
    return page.Contains(kHtml) ? page : page + kHtml;
}

// One row of label, field and status between side spacers. The toolkit ignores
// (and in 3.2 rejects) alignment along a box sizer's own direction and beside
// wxEXPAND, so rows and controls carry only the alignment that takes effect.
wxBoxSizer* Row(int leftSpace, std::initializer_list<wxWindow*> windows)
{
    auto* row = new wxBoxSizer(wxHORIZONTAL);
    row->Add(leftSpace, 0, 0);
    for (wxWindow* window : windows)
        row->Add(window, 0, wxALIGN_CENTER_VERTICAL | wxALL, 2);
    row->Add(15, 0, 0);
    return row;
}

} // namespace

// clang-format off
wxBEGIN_EVENT_TABLE(CHelpToolDlg, ZelCommonDlg)
wxEND_EVENT_TABLE()
// clang-format on

wxIMPLEMENT_DYNAMIC_CLASS(CHelpToolDlg, wxDialog);

CHelpToolDlg::CHelpToolDlg() = default;

CHelpToolDlg::CHelpToolDlg(const wxString& appName, const wxString& page, wxWindow* parent,
                           wxWindowID id, const wxString& title, const wxPoint& pos,
                           const wxSize& size, long style)
    : m_appName(appName), m_page(WithHtml(page))
{
    Create(parent, id, title, pos, size, style);
    Centre(wxBOTH);
}

bool CHelpToolDlg::Create(wxWindow* parent, wxWindowID id, const wxString& title,
                          const wxPoint& pos, const wxSize& size, long style)
{
    SetExtraStyle(wxWS_EX_BLOCK_EVENTS | wxDIALOG_EX_CONTEXTHELP);
    if (!wxDialog::Create(parent, id, title, pos, size, style))
        return false;
    CreateControls();
    return true;
}

void CHelpToolDlg::CreateControls()
{
    auto* mainSizer = new wxBoxSizer(wxVERTICAL);
    mainSizer->Add(0, 10, 0);

    m_titleLabel = new wxStaticText(this, wxID_STATIC, "Help file information");
    auto* titleRow = new wxBoxSizer(wxHORIZONTAL);
    titleRow->Add(15, 0, 0);
    titleRow->Add(m_titleLabel, 0, wxALIGN_CENTER_VERTICAL | wxALL, 2);
    mainSizer->Add(titleRow, 0);
    mainSizer->Add(0, 20, 0);

    const wxSize fieldSize(kFieldWidth, -1);
    m_preferredLabel = new wxStaticText(this, wxID_STATIC, "Preferred:");
    m_preferredField =
        new HelpToolTextCtrl(this, 0, m_page, wxDefaultPosition, fieldSize, wxTE_READONLY);
    m_preferredStatus = new wxStaticText(this, wxID_STATIC, "Not Found!", wxDefaultPosition,
                                         wxDefaultSize, wxALIGN_RIGHT);
    mainSizer->Add(Row(15, {m_preferredLabel, m_preferredField, m_preferredStatus}), 0, wxEXPAND);

    m_alternateLabel = new wxStaticText(this, wxID_STATIC, "Alternate:");
    m_alternateField =
        new HelpToolTextCtrl(this, 0, kAlternatePage, wxDefaultPosition, fieldSize, wxTE_READONLY);
    m_alternateStatus = new wxStaticText(this, wxID_STATIC, "Not Found!", wxDefaultPosition,
                                         wxDefaultSize, wxALIGN_RIGHT);
    mainSizer->Add(Row(15, {m_alternateLabel, m_alternateField, m_alternateStatus}), 0, wxEXPAND);

    const wxString path = BuildHelpPath(m_page);
    m_pathLabel = new wxStaticText(this, wxID_STATIC, "       Path:");
    m_pathField = new HelpToolTextCtrl(this, 0, path, wxDefaultPosition, fieldSize, wxTE_READONLY);
    mainSizer->Add(Row(17, {m_pathLabel, m_pathField}), 0, wxEXPAND);
    mainSizer->Add(0, 10, 0);

    m_okButton = new wxButton(this, wxID_OK, "&OK");
    auto* buttonRow = new wxBoxSizer(wxHORIZONTAL);
    buttonRow->Add(m_okButton, 0, wxALL, 2);
    buttonRow->Add(15, 0, 0);
    mainSizer->Add(buttonRow, 0, wxALIGN_RIGHT);
    mainSizer->Add(0, 20, 0);

    if (wxFileExists(path))
        m_preferredStatus->SetLabel("Found!");
    if (wxFileExists(BuildHelpPath(kAlternatePage)))
        m_alternateStatus->SetLabel("Found!");
    m_okButton->SetDefault();
    m_okButton->SetFocus();
    SetSizer(mainSizer);
    mainSizer->SetSizeHints(this);
}

wxString CHelpToolDlg::BuildHelpPath(const wxString& page) const
{
    const wxString installDir = wxFileName(wxStandardPaths::Get().GetExecutablePath())
                                    .GetPath(wxPATH_GET_VOLUME | wxPATH_GET_SEPARATOR);
    const wxString separator(wxFILE_SEP_PATH);
    const wxString helpFolder =
        wxString("Documentation") + separator + GetHelpLanguage() + separator + "Help" + separator;
    for (const ProgramHelp& program : kProgramHelp) {
        if (m_appName == program.appName) {
            const wxString subFolder = program.subFolder;
            return installDir + helpFolder + (subFolder.empty() ? "" : subFolder + separator) +
                   WithHtml(page);
        }
    }
    return installDir;
}

wxString CHelpToolDlg::GetHelpLanguage() const
{
    return HelpFolderLanguage(GetUserLanguageName());
}
