// The launcher window's client panel: the launcher picture with the two column
// titles, painted flicker-free through a back buffer, its fixed best size and
// the hook for the module buttons' state.
#pragma once

#include <wx/bitmap.h>
#include <wx/colour.h>
#include <wx/font.h>
#include <wx/panel.h>

class Veltro3MainAppDialogController : public wxPanel
{
public:
    Veltro3MainAppDialogController(wxWindow* parent, wxWindowID id, const wxPoint& pos,
                                   const wxSize& size, long style, const wxString& name);
    ~Veltro3MainAppDialogController() override;

    virtual void OnSysColourChanged(wxSysColourChangedEvent& event);
    virtual void OnPaint(wxPaintEvent& event);
    virtual void OnEraseBackground(wxEraseEvent& event);
    // The panel takes no text: it keeps no input method (see DropInputMethod).
    virtual void OnWindowCreate(wxWindowCreateEvent& event);
    virtual void UpdateModuleButtons();
    // Draws over the background into the back buffer.
    virtual void DrawContent(wxDC& dc);

    // Every refresh re-renders the back buffer.
    void Refresh(bool eraseBackground = true, const wxRect* rect = nullptr) override;

protected:
    wxSize DoGetBestSize() const override;
    void DrawBackground(wxDC& dc);
    const wxColour& GetViewColour() const { return m_viewColour; }
    void ResetViewColour();

private:
    wxBitmap m_backBuffer;
    wxBitmap m_background;
    wxFont m_titleFont;
    wxColour m_viewColour;
    bool m_dirty = true;

    wxDECLARE_EVENT_TABLE();
};

// A picture that can be drawn: loaded, and not empty.
bool IsUsablePicture(const wxBitmap& bitmap);
