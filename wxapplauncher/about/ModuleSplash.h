// The module information window: a borderless picture with a module's name, version
// and legal lines, open until the first click, key or loss of activation.
#pragma once

#include <wx/arrstr.h>
#include <wx/bitmap.h>
#include <wx/dialog.h>

class ZelModuleSplashScreen : public wxDialog
{
public:
    // Creates and shows the window, which keeps its own copy of the lines and destroys
    // itself when it closes.
    ZelModuleSplashScreen(int id, const wxArrayString& lines);
    ~ZelModuleSplashScreen() override;

private:
    void OnCloseWindow(wxCloseEvent& event);
    void OnMouseEvent(wxMouseEvent& event);
    void OnCaptureLost(wxMouseCaptureLostEvent& event);
    void OnKeyOrFocusLoss(wxFocusEvent& event);
    void OnKeyOrFocusLoss(wxKeyEvent& event);
    void OnDeactivate(wxActivateEvent& event);
    void OnPaint(wxPaintEvent& event);

    wxBitmap m_picture;
    wxArrayString m_lines;

    wxDECLARE_EVENT_TABLE();
};

// A picture of the common image set by its resource name, for a display of the given
// scale; the first call registers the image handlers and the set.
wxBitmap LoadCommonBitmap(const wxString& name, double scale);
