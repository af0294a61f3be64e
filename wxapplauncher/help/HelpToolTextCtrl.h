// The help tool's read-only fields: Ctrl+A and Ctrl+C copy the whole text,
// Enter and Escape close the dialog as its OK button and a cancel would.
#pragma once

#include <wx/textctrl.h>

class HelpToolTextCtrl : public wxTextCtrl
{
public:
    HelpToolTextCtrl(wxWindow* parent, wxWindowID id, const wxString& value = wxString(),
                     const wxPoint& pos = wxDefaultPosition, const wxSize& size = wxDefaultSize,
                     long style = 0, const wxValidator& validator = wxDefaultValidator,
                     const wxString& name = wxTextCtrlNameStr);

    void OnKeyDown(wxKeyEvent& event);

private:
    wxDECLARE_EVENT_TABLE();
};
