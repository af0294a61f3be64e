// A static text that acts as a web link: blue and underlined, red with a hand
// cursor under the pointer, and opening its address when clicked. It is the
// toolkit's generic static text: the native GTK label has no window of its
// own and never sees the mouse.
#pragma once

#include <wx/cursor.h>
#include <wx/stattext.h>

// After the port's own static text, which the generic header leaves out.
#include <wx/generic/stattextg.h>

class wxActivateEvent;
class wxMouseEvent;

class ZelLinkText : public wxGenericStaticText
{
public:
    // The address is the label when `url` is empty; it is also the tool tip.
    ZelLinkText(wxWindow* parent, wxWindowID id, const wxString& label, const wxString& url,
                const wxPoint& pos = wxDefaultPosition, const wxSize& size = wxDefaultSize,
                long style = 0, const wxString& name = wxStaticTextNameStr);

    const wxString& GetURL() const { return m_url; }

    void OnMouse(wxMouseEvent& event);
    void OnActivate(wxActivateEvent& event);

private:
    void ShowNormal();

    wxCursor m_savedCursor;
    wxString m_url;

    wxDECLARE_EVENT_TABLE();
};
