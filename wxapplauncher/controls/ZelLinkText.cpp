#include "controls/ZelLinkText.h"

#include "help/Documentation.h"

#include <wx/app.h>
#include <wx/toplevel.h>

// clang-format off
wxBEGIN_EVENT_TABLE(ZelLinkText, wxGenericStaticText)
    EVT_MOUSE_EVENTS(ZelLinkText::OnMouse)
wxEND_EVENT_TABLE()
// clang-format on

ZelLinkText::ZelLinkText(wxWindow* parent, wxWindowID id, const wxString& label,
                         const wxString& url, const wxPoint& pos, const wxSize& size, long style,
                         const wxString& name)
    : wxGenericStaticText(parent, id, label, pos, size, style, name),
      m_url(url.empty() ? label : url)
{
    SetForegroundColour(*wxBLUE);
    SetFont(GetFont().Underlined());
    m_savedCursor = GetCursor();
    SetToolTip(m_url);

    // Activation is only told to top-level windows and the application; the
    // connections end with this window.
    if (wxWindow* top = wxGetTopLevelParent(this))
        top->Bind(wxEVT_ACTIVATE, &ZelLinkText::OnActivate, this);
    if (wxTheApp)
        wxTheApp->Bind(wxEVT_ACTIVATE_APP, &ZelLinkText::OnActivate, this);
}

void ZelLinkText::ShowNormal()
{
    SetForegroundColour(*wxBLUE);
    SetCursor(m_savedCursor);
}

void ZelLinkText::OnMouse(wxMouseEvent& event)
{
    if (event.LeftUp()) {
        ShowNormal();
        OpenURL(m_url);
    } else if (event.Entering()) {
        SetForegroundColour(*wxRED);
        m_savedCursor = GetCursor();
        SetCursor(wxCursor(wxCURSOR_HAND));
        Refresh();
    } else if (event.Leaving()) {
        ShowNormal();
        Refresh();
    }
    event.Skip();
}

void ZelLinkText::OnActivate(wxActivateEvent& event)
{
    if (!event.GetActive())
        ShowNormal();
    Refresh();
    event.Skip();
}
