// The shaped picture window of the start-up splash and the About box: the picture
// pre-blended with the desktop beneath it, and a window onto text rendered once,
// which the About box scrolls upward without end.
#pragma once

#include <wx/arrstr.h>
#include <wx/bitmap.h>
#include <wx/colour.h>
#include <wx/dcmemory.h>
#include <wx/frame.h>
#include <wx/image.h>
#include <wx/timer.h>

#include <vector>

class ZelSplashScreen : public wxFrame
{
public:
    // Creates, shows and starts the window; it destroys itself when it closes.
    ZelSplashScreen(int id, bool startup, int milliseconds, const wxBitmap& picture,
                    const wxArrayString& lines, const wxPoint& textCentre, int windowLineCount,
                    int margin, const wxColour& colour);
    ~ZelSplashScreen() override;

protected:
    // For subclasses that finish their own set-up before calling Start, so that no event
    // can reach them half made.
    ZelSplashScreen() = default;
    void Start(int id, bool startup, int milliseconds, const wxBitmap& picture,
               const wxArrayString& lines, const wxPoint& textCentre, int windowLineCount,
               int margin, const wxColour& colour);

    void OnCloseWindow(wxCloseEvent& event);
    bool TimerRunning() const { return m_timer.IsRunning(); }

private:
    void BlendWithScreen();
    void UpdateText();
    void WaitForFirstPaint();

    void OnTimer(wxTimerEvent& event);
    void OnMouseEvent(wxMouseEvent& event);
    void OnCaptureLost(wxMouseCaptureLostEvent& event);
    void OnKeyOrFocusLoss(wxFocusEvent& event);
    void OnKeyOrFocusLoss(wxKeyEvent& event);
    void OnDeactivate(wxActivateEvent& event);
    void OnPaint(wxPaintEvent& event);
    void OnEraseBackground(wxEraseEvent& event);

    wxBitmap m_composite;
    wxBitmap m_background;
    // The text window's part of the background, and the text's coverage, row by row, in
    // physical pixels.
    wxImage m_textBackground;
    wxImage m_textFrame; // the text window being composed, made once
    std::vector<unsigned char> m_textAlpha;
    wxSize m_textSize;
    int m_scale = 1;
    wxRect m_textWindow;
    wxTimer m_timer;
    bool m_startup = false;
    int m_milliseconds = 0;
    int m_scrollOffset = 0;
    bool m_painted = false;
    wxColour m_colour;
    wxMemoryDC m_compositeDC;

    wxDECLARE_EVENT_TABLE();
};

class ZelAboutSplashScreen : public ZelSplashScreen
{
public:
    // closeAllowed: whether the user may close the window before its timer has fired.
    ZelAboutSplashScreen(int id, bool startup, int milliseconds, const wxBitmap& picture,
                         const wxArrayString& lines, const wxPoint& textCentre, int windowLineCount,
                         int margin, const wxColour& colour, bool closeAllowed);

private:
    void OnCloseWindow(wxCloseEvent& event);

    bool m_closeAllowed = false;

    wxDECLARE_EVENT_TABLE();
};

// The text's font: the system font's face at 8 points, or 7 when a character of it is
// taller than 16 pixels on the window.
wxFont SplashTextFont(wxWindow* window);

// Where the text window lies on a picture of the given width: centred on textCentre,
// but kept within the margins, the left one first.
wxRect PlaceTextWindow(int pictureWidth, const wxSize& text, const wxPoint& textCentre, int height,
                       int margin);
