#include "help/HelpToolTextCtrl.h"

// clang-format off
wxBEGIN_EVENT_TABLE(HelpToolTextCtrl, wxTextCtrl)
    EVT_KEY_DOWN(HelpToolTextCtrl::OnKeyDown)
wxEND_EVENT_TABLE()
    // clang-format on

    HelpToolTextCtrl::HelpToolTextCtrl(wxWindow* parent, wxWindowID id, const wxString& value,
                                       const wxPoint& pos, const wxSize& size, long style,
                                       const wxValidator& validator, const wxString& name)
    : wxTextCtrl(parent, id, value, pos, size, style, validator, name)
{
}

void HelpToolTextCtrl::OnKeyDown(wxKeyEvent& event)
{
    const int key = event.GetKeyCode();
    if (event.ControlDown() && key == 'A')
        SetSelection(-1, -1);
    if (event.ControlDown() && key == 'C')
        Copy();

    int button = wxID_NONE;
    if (key == WXK_RETURN || key == WXK_NUMPAD_ENTER)
        button = wxID_OK;
    else if (key == WXK_ESCAPE)
        button = wxID_CANCEL;
    if (button != wxID_NONE) {
        // Travels up to the dialog, whose default handling ends it with this id.
        wxCommandEvent click(wxEVT_BUTTON, button);
        click.SetEventObject(this);
        GetEventHandler()->ProcessEvent(click);
    }
    // Not skipped: no key reaches the field itself.
}
