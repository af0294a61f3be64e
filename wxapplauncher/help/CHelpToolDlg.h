// The help tool dialog: which help page the current program would show, where
// it must lie in the installation, and whether it and the fallback page are there.
#pragma once

#include "help/ZelCommonDlg.h"

class wxButton;
class wxStaticText;
class HelpToolTextCtrl;

class CHelpToolDlg : public ZelCommonDlg
{
public:
    CHelpToolDlg();
    CHelpToolDlg(const wxString& appName, const wxString& page, wxWindow* parent, wxWindowID id,
                 const wxString& title, const wxPoint& pos, const wxSize& size, long style);

    bool Create(wxWindow* parent, wxWindowID id, const wxString& title, const wxPoint& pos,
                const wxSize& size, long style);
    void CreateControls();

    // The full path where the help page `page` of m_appName lies; the
    // installation folder itself for a program the suite does not know.
    wxString BuildHelpPath(const wxString& page) const;
    // The help folder of the user's language ("de", "en", ...).
    wxString GetHelpLanguage() const;

    wxString m_appName;
    wxString m_page;
    wxStaticText* m_titleLabel = nullptr;
    wxStaticText* m_preferredLabel = nullptr;
    wxStaticText* m_alternateLabel = nullptr;
    wxStaticText* m_pathLabel = nullptr;
    HelpToolTextCtrl* m_preferredField = nullptr;
    HelpToolTextCtrl* m_alternateField = nullptr;
    HelpToolTextCtrl* m_pathField = nullptr;
    wxStaticText* m_preferredStatus = nullptr;
    wxStaticText* m_alternateStatus = nullptr;
    wxButton* m_okButton = nullptr;

private:
    wxDECLARE_DYNAMIC_CLASS(CHelpToolDlg);
    wxDECLARE_EVENT_TABLE();
};
