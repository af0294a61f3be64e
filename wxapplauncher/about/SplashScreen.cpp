#include "about/SplashScreen.h"

#include "about/PictureWindow.h"
#include "controls/TextBitmap.h"

#include "platform/DisplayScale.h"
#include "platform/ScreenCapture.h"

#include <wx/app.h>
#include <wx/dcclient.h>
#include <wx/dcmemory.h>
#include <wx/settings.h>
#include <wx/time.h>
#include <wx/utils.h>

#include <algorithm>
#include <cstring>

namespace {

const int kStartupPixelsPerLine = 10;
const int kAboutPixelsPerLine = 7;
const int kScrollPeriodMs = 80;
// The lowest rows of the text window show the picture while the text does not wrap.
const int kPictureRows = 10;
const int kLargeCharHeight = 16;
// How long start-up waits for the splash to be mapped and painted; the window manager
// answers in a few milliseconds.
const int kFirstPaintWaitMs = 250;

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

    // The window's own units; the picture may have more physical ones on a scaled display.
    // The text's place and lines are given in device-independent pixels.
    const wxSize size = picture.IsOk() ? picture.GetLogicalSize() : wxSize(0, 0);
    const double scale = picture.IsOk() ? picture.GetScaleFactor() : 1.0;
    SetSize(size);
    CentreOnPrimaryDisplay(this, size);
    ShapeToPicture(this, m_background);

    const int perLine = startup ? kStartupPixelsPerLine : kAboutPixelsPerLine;
    const int height = std::min(int(lines.size()), windowLineCount) * perLine;
    const wxFont font = SplashTextFont(this);
    m_scale = std::max(1, wxRound(scale));
    {
        // Of the text only its coverage is kept, a byte a pixel: its colour is one for all.
        // Rendered before the blend, so that its buffers and the blend's never coexist.
        const wxImage text = DrawTextLinesToImage(wxDefaultSize, wxDefaultPosition, font, lines,
                                                  m_colour, 0, -1, scale);
        if (text.IsOk() && text.HasAlpha()) {
            m_textSize = text.GetSize();
            m_textAlpha.assign(text.GetAlpha(),
                               text.GetAlpha() + std::size_t(m_textSize.x) * m_textSize.y);
        }
    }
    // Without children the window itself must take the keyboard focus, or keys never reach it.
    SetCanFocus(true);
    SetFocus();
    Raise();
    // What lies beneath must be painted before it is captured.
    if (wxWindow* top = wxTheApp->GetTopWindow())
        top->Update();
    BlendWithScreen();

    // Left to the theme, each device context made on the window, two per paint, would look
    // the window's font and colours up in it again.
    SetOwnFont(font);
    SetOwnForegroundColour(m_colour);
    SetOwnBackgroundColour(GetBackgroundColour());
    if (m_background.IsOk() && !m_textAlpha.empty())
        m_textWindow = PlaceTextWindow(size.x, FromDIP(m_textSize / m_scale), FromDIP(textCentre),
                                       FromDIP(height), FromDIP(margin));
    // Only the text window of the background is ever copied again; the rest of the picture
    // becomes the composite itself, not a copy of it.
    if (!m_textWindow.IsEmpty()) {
        m_textBackground = m_background.GetSubBitmap(m_textWindow).ConvertToImage();
        // The text is laid on opaque pixels; only an unblended picture still has alpha.
        if (m_textBackground.HasAlpha())
            m_textBackground.ClearAlpha();
    }
    m_composite = m_background;
    m_background = wxBitmap();
    // Made once: each paint only copies from it.
    if (m_composite.IsOk())
        m_compositeDC.SelectObject(m_composite);

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
    if (m_startup)
        WaitForFirstPaint();
}

void ZelSplashScreen::WaitForFirstPaint()
{
    // Mapping a window is asynchronous on X11: left alone, the splash would first be
    // painted once start-up has built the main frame, the very wait it is there to cover.
    const wxLongLong deadline = wxGetLocalTimeMillis() + kFirstPaintWaitMs;
    while (!m_painted && IsShown() && wxGetLocalTimeMillis() < deadline) {
        wxMilliSleep(1);
        wxSafeYield(nullptr, false);
    }
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
    if (!m_background.IsOk() || !m_background.HasAlpha())
        return;
    // Without a capture (no X11 desktop) the picture is shown unblended. Captured first:
    // the server's reply is gone before the picture is converted.
    wxImage blended = CaptureScreen(wxRect(GetPosition(), m_background.GetLogicalSize()));
    if (!blended.IsOk() || !blended.GetData() || blended.GetSize() != m_background.GetSize())
        return;
    {
        const wxImage picture = m_background.ConvertToImage();
        if (!picture.IsOk() || !picture.HasAlpha() || !picture.GetData())
            return;
        const int width = picture.GetWidth(), height = picture.GetHeight();
        unsigned char* out = blended.GetData();
        const unsigned char* in = picture.GetData();
        const unsigned char* alpha = picture.GetAlpha();
        for (size_t i = 0, n = size_t(width) * size_t(height); i < n; ++i) {
            const unsigned a = alpha[i];
            for (int c = 0; c < 3; ++c, ++out, ++in)
                *out = static_cast<unsigned char>((*out * (255 - a) + *in * a) / 255);
        }
    }
    // The loaded picture goes before the blend becomes a bitmap: the two would only add
    // to the window's peak memory.
    const double scale = m_background.GetScaleFactor();
    m_background = wxBitmap();
    m_background = ScaledBitmap(blended, scale);
}

void ZelSplashScreen::UpdateText()
{
    if (!m_composite.IsOk() || m_textAlpha.empty() || !m_textBackground.IsOk() ||
        m_textWindow.IsEmpty())
        return;
    // Physical pixels: the text and the background have the display's own.
    const int k = m_scale, stride = m_textBackground.GetWidth() * 3;
    const int w = std::min(m_textBackground.GetWidth(), m_textSize.x);
    const int h = m_textBackground.GetHeight(), total = m_textSize.y, s = m_scrollOffset * k;
    if (!m_textFrame.IsOk())
        m_textFrame.Create(m_textBackground.GetSize(), false);
    unsigned char* out = m_textFrame.GetData();
    std::memcpy(out, m_textBackground.GetData(), std::size_t(stride) * std::size_t(h));
    const unsigned char colour[3] = {m_colour.Red(), m_colour.Green(), m_colour.Blue()};
    // The text's rows from `fromRow` over the window's rows from `atRow`, by their coverage.
    auto draw = [&](int fromRow, int rows, int atRow) {
        for (int r = 0; r < rows; ++r) {
            const unsigned char* alpha =
                &m_textAlpha[std::size_t(fromRow + r) * std::size_t(m_textSize.x)];
            unsigned char* pixel = out + std::size_t(atRow + r) * std::size_t(stride);
            for (int x = 0; x < w; ++x, ++alpha, pixel += 3) {
                // Most of the window lies between the glyphs.
                if (*alpha == 0)
                    continue;
                for (int c = 0; c < 3; ++c)
                    pixel[c] = static_cast<unsigned char>(
                        (pixel[c] * (255 - *alpha) + colour[c] * *alpha) / 255);
            }
        }
    };
    if (total <= h) {
        // Text shorter than its window: shown once, never a second copy below it.
        draw(s, total - s, 0);
    } else if (s + h <= total) {
        draw(s, h - kPictureRows * k, 0);
    } else {
        // Past the end the text continues with its first line, without a gap.
        draw(s, total - s, 0);
        draw(0, h - (total - s), total - s);
    }
    m_compositeDC.DrawBitmap(ScaledBitmap(m_textFrame, k), m_textWindow.x, m_textWindow.y, false);
    // The top-level window's own Refresh repaints the whole window whatever rectangle it
    // is given; the plain window's invalidates only the text window.
    wxWindow::Refresh(false, &m_textWindow);
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
    if (++m_scrollOffset >= m_textSize.y / m_scale)
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
    m_painted = true;
    if (!m_composite.IsOk())
        return;
    for (wxRegionIterator r(GetUpdateRegion()); r; ++r)
        dc.Blit(r.GetX(), r.GetY(), r.GetW(), r.GetH(), &m_compositeDC, r.GetX(), r.GetY(), wxCOPY,
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
