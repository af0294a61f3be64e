#include "about/SplashScreen.h"

#include "about/PictureWindow.h"
#include "controls/TextBitmap.h"

#include "platform/ScreenCapture.h"

#include <wx/app.h>
#include <wx/dcclient.h>
#include <wx/dcmemory.h>
#include <wx/settings.h>
#include <wx/utils.h>

#include <algorithm>

namespace {

const int kStartupPixelsPerLine = 10;
const int kAboutPixelsPerLine = 7;
const int kScrollPeriodMs = 80;
// The lowest rows of the text window show the picture while the text does not wrap.
const int kPictureRows = 10;
const int kLargeCharHeight = 16;

} // namespace

// clang-format off
wxBEGIN_EVENT_TABLE(ZelSplashScreen, wxFrame)
    EVT_TIMER(wxID_ANY, ZelSplashScreen::OnTimer)
    EVT_CLOSE(ZelSplashScreen::OnCloseWindow)
    EVT_MOUSE_EVENTS(ZelSplashScreen::OnMouseEvent)
    EVT_MOUSE_CAPTURE_LOST(ZelSplashScreen::OnCaptureLost)
    EVT_KILL_FOCUS(ZelSplashScreen::OnKeyOrFocusLoss)
    EVT_ACTIVATE(ZelSplashScreen::OnDeactivate)
    EVT_ACTIVATE_APP(ZelSplashScreen::OnDeactivate)
    EVT_CHAR(ZelSplashScreen::OnKeyOrFocusLoss)
    EVT_PAINT(ZelSplashScreen::OnPaint)
    EVT_ERASE_BACKGROUND(ZelSplashScreen::OnEraseBackground)
wxEND_EVENT_TABLE()

wxBEGIN_EVENT_TABLE(ZelAboutSplashScreen, ZelSplashScreen)
    EVT_CLOSE(ZelAboutSplashScreen::OnCloseWindow)
wxEND_EVENT_TABLE()
    // clang-format on

    wxFont SplashTextFont(wxWindow* window)
{
    const wxString face = wxSystemSettings::GetFont(wxSYS_DEFAULT_GUI_FONT).GetFaceName();
    wxFont font(8, wxFONTFAMILY_SWISS, wxFONTSTYLE_NORMAL, wxFONTWEIGHT_NORMAL, false, face);
    wxClientDC dc(window);
    dc.SetFont(font);
    if (dc.GetCharHeight() > kLargeCharHeight)
        font.SetPointSize(7);
    return font;
}

wxRect PlaceTextWindow(int pictureWidth, const wxSize& text, const wxPoint& textCentre, int height,
                       int margin)
{
    wxRect window(textCentre.x - text.x / 2, textCentre.y - height / 2, text.x, height);
    if (window.y < margin)
        window.y = margin;
    if (window.x + text.x > pictureWidth - margin)
        window.x = pictureWidth - text.x - margin;
    if (window.x < margin)
        window.x = margin;
    return window;
}

ZelSplashScreen::ZelSplashScreen(int id, bool startup, int milliseconds, const wxBitmap& picture,
                                 const wxArrayString& lines, const wxPoint& textCentre,
                                 int windowLineCount, int margin, const wxColour& colour)
{
    Start(id, startup, milliseconds, picture, lines, textCentre, windowLineCount, margin, colour);
}

void ZelSplashScreen::Start(int id, bool startup, int milliseconds, const wxBitmap& picture,
                            const wxArrayString& lines, const wxPoint& textCentre,
                            int windowLineCount, int margin, const wxColour& colour)
{
    Create(nullptr, id, wxString(), wxDefaultPosition, wxDefaultSize,
           wxNO_BORDER | wxSTAY_ON_TOP | wxFRAME_SHAPED | wxFRAME_NO_TASKBAR);
    m_background = picture;
    m_startup = startup;
    m_milliseconds = milliseconds;
    m_colour = colour;
    wxSafeYield(nullptr, false);

    const wxSize size = picture.IsOk() ? picture.GetSize() : wxSize(0, 0);
    SetSize(size);
    CentreOnPrimaryDisplay(this, size);
    ShapeToPicture(this, m_background);

    // Without children the window itself must take the keyboard focus, or keys never reach it.
    SetCanFocus(true);
    SetFocus();
    Raise();
    // What lies beneath must be painted before it is captured.
    if (wxWindow* top = wxTheApp->GetTopWindow())
        top->Update();
    BlendWithScreen();

    const int perLine = startup ? kStartupPixelsPerLine : kAboutPixelsPerLine;
    const int height = std::min(int(lines.size()), windowLineCount) * perLine;
    m_text = DrawTextLinesToBitmap(wxDefaultSize, wxDefaultPosition, SplashTextFont(this), lines,
                                   m_colour, 0, -1);
    if (m_background.IsOk())
        m_composite = m_background.GetSubBitmap(wxRect(size));
    if (m_composite.IsOk() && m_text.IsOk())
        m_textWindow = PlaceTextWindow(size.x, m_text.GetSize(), textCentre, height, margin);

    m_scrollOffset = 0;
    Show(true);
    // Raising before the window is mapped does not activate it on X11; without activation
    // it would see neither keys nor the loss of activation that closes it.
    if (!m_startup)
        Raise();
    UpdateText();

    if (m_milliseconds != 0) {
        // The timer keeps wxID_ANY: a fresh id per window would stay reserved for good.
        m_timer.SetOwner(this);
        m_timer.StartOnce(m_milliseconds);
    }
    // A pointer grab on X11 takes every click on the screen; the start-up splash ignores
    // input, so it takes none.
    if (!m_startup && !HasCapture())
        CaptureMouse();
}

ZelSplashScreen::~ZelSplashScreen()
{
    Hide();
    m_timer.Stop();
    if (HasCapture())
        ReleaseMouse();
}

void ZelSplashScreen::BlendWithScreen()
{
    if (!m_background.IsOk())
        return;
    const wxImage picture = m_background.ConvertToImage();
    if (!picture.IsOk() || !picture.HasAlpha() || !picture.GetData())
        return;
    const int width = picture.GetWidth(), height = picture.GetHeight();
    // Without a capture (no X11 desktop) the picture is shown unblended.
    wxImage blended = CaptureScreen(wxRect(GetPosition(), picture.GetSize()));
    if (!blended.IsOk() || !blended.GetData())
        return;
    unsigned char* out = blended.GetData();
    const unsigned char* in = picture.GetData();
    const unsigned char* alpha = picture.GetAlpha();
    for (size_t i = 0, n = size_t(width) * size_t(height); i < n; ++i) {
        const unsigned a = alpha[i];
        for (int c = 0; c < 3; ++c, ++out, ++in)
            *out = static_cast<unsigned char>((*out * (255 - a) + *in * a) / 255);
    }
    m_background = wxBitmap(blended);
}

void ZelSplashScreen::UpdateText()
{
    if (!m_composite.IsOk() || !m_text.IsOk() || m_textWindow.IsEmpty())
        return;
    const int x = m_textWindow.x, y = m_textWindow.y, w = m_textWindow.width;
    const int h = m_textWindow.height, total = m_text.GetHeight(), s = m_scrollOffset;
    {
        wxMemoryDC composite(m_composite);
        wxMemoryDC background(m_background);
        composite.Blit(x, y, w, h, &background, x, y, wxCOPY, false);
        background.SelectObject(wxNullBitmap);
        auto draw = [&](int fromRow, int rows, int atY) {
            if (rows > 0)
                composite.DrawBitmap(m_text.GetSubBitmap(wxRect(0, fromRow, w, rows)), x, atY,
                                     true);
        };
        if (total <= h) {
            // Text shorter than its window: shown once, never a second copy below it.
            draw(s, total - s, y);
        } else if (s + h <= total) {
            draw(s, h - kPictureRows, y);
        } else {
            // Past the end the text continues with its first line, without a gap.
            draw(s, total - s, y);
            draw(0, h - (total - s), y + total - s);
        }
    }
    RefreshRect(m_textWindow, false);
    Update();
}

void ZelSplashScreen::OnTimer(wxTimerEvent&)
{
    if (m_startup) {
        Close(true);
        return;
    }
    if (m_timer.IsOneShot())
        m_timer.Start(kScrollPeriodMs, wxTIMER_CONTINUOUS);
    if (++m_scrollOffset >= m_text.GetHeight())
        m_scrollOffset = 0;
    UpdateText();
}

void ZelSplashScreen::OnCloseWindow(wxCloseEvent&)
{
    if (HasCapture())
        ReleaseMouse();
    m_timer.Stop();
    Destroy();
}

void ZelSplashScreen::OnMouseEvent(wxMouseEvent& event)
{
    if (event.ButtonDown(wxMOUSE_BTN_ANY))
        Close(false);
    event.Skip();
}

void ZelSplashScreen::OnCaptureLost(wxMouseCaptureLostEvent&)
{
    // Without the capture the click that should close the window may never come.
    Close(false);
}

void ZelSplashScreen::OnKeyOrFocusLoss(wxFocusEvent& event)
{
    Close(false);
    event.Skip();
}

void ZelSplashScreen::OnKeyOrFocusLoss(wxKeyEvent& event)
{
    Close(false);
    event.Skip();
}

void ZelSplashScreen::OnDeactivate(wxActivateEvent& event)
{
    if (!event.GetActive())
        Close(false);
    event.Skip();
}

void ZelSplashScreen::OnPaint(wxPaintEvent&)
{
    wxPaintDC dc(this);
    if (!m_composite.IsOk())
        return;
    wxMemoryDC composite(m_composite);
    for (wxRegionIterator r(GetUpdateRegion()); r; ++r)
        dc.Blit(r.GetX(), r.GetY(), r.GetW(), r.GetH(), &composite, r.GetX(), r.GetY(), wxCOPY,
                false);
}

void ZelSplashScreen::OnEraseBackground(wxEraseEvent&) {}

ZelAboutSplashScreen::ZelAboutSplashScreen(int id, bool startup, int milliseconds,
                                           const wxBitmap& picture, const wxArrayString& lines,
                                           const wxPoint& textCentre, int windowLineCount,
                                           int margin, const wxColour& colour, bool closeAllowed)
    : m_closeAllowed(closeAllowed)
{
    Start(id, startup, milliseconds, picture, lines, textCentre, windowLineCount, margin, colour);
}

void ZelAboutSplashScreen::OnCloseWindow(wxCloseEvent& event)
{
    if (TimerRunning() && !m_closeAllowed)
        return;
    ZelSplashScreen::OnCloseWindow(event);
}
