#include "controls/ZelStaticBitmap.h"

#include "platform/ButtonAccessibility.h"
#include "platform/DisplayScale.h"
#include "platform/KeyboardFocus.h"

#include <wx/dcclient.h>
#include <wx/dcmemory.h>
#include <wx/image.h>
#include <wx/settings.h>

#include <algorithm>

namespace {

// a × (1 - t) + b × t per channel, truncated.
wxColour Mix(const wxColour& a, const wxColour& b, float t)
{
    auto channel = [t](unsigned char x, unsigned char y) {
        return static_cast<unsigned char>(x * (1.0f - t) + y * t);
    };
    return wxColour(channel(a.Red(), b.Red()), channel(a.Green(), b.Green()),
                    channel(a.Blue(), b.Blue()));
}

wxColour SysColour(wxSystemColour index)
{
    return wxSystemSettings::GetColour(index);
}

void SetPenColour(wxDC& dc, const wxColour& colour)
{
    dc.SetPen(wxPen(colour, 1, wxPENSTYLE_SOLID));
}

} // namespace

// clang-format off
wxBEGIN_EVENT_TABLE(ZelStaticBitmap, wxControl)
    EVT_SYS_COLOUR_CHANGED(ZelStaticBitmap::OnSysColourChanged)
    EVT_ERASE_BACKGROUND(ZelStaticBitmap::OnEraseBackground)
    EVT_PAINT(ZelStaticBitmap::OnPaint)
    EVT_MOVE(ZelStaticBitmap::OnMove)
    EVT_MOUSE_EVENTS(ZelStaticBitmap::OnMouse)
    EVT_KILL_FOCUS(ZelStaticBitmap::OnKillFocus)
    EVT_SET_FOCUS(ZelStaticBitmap::OnSetFocus)
    EVT_KEY_DOWN(ZelStaticBitmap::OnKeyDown)
    EVT_MOUSE_CAPTURE_LOST(ZelStaticBitmap::OnCaptureLost)
    EVT_WINDOW_CREATE(ZelStaticBitmap::OnWindowCreate)
wxEND_EVENT_TABLE()
// clang-format on

ZelStaticBitmap::ZelStaticBitmap(wxWindow* parent, wxWindowID id, const wxBitmap& bitmap,
                                 const wxPoint& pos, const wxSize& size, long style,
                                 const wxString& name)
    : m_bitmap(bitmap), m_framed((style & ZSB_FRAMED) != 0)
{
    if (m_framed)
        style = (style & ~ZSB_FRAMED) | wxNO_BORDER;
    wxControl::Create(parent, id, pos, size, style, wxDefaultValidator, name);
    SetBitmap(bitmap);
    SetInitialSize(size);
    ExposeAsButton(this, {[this] { return !GetLabel().empty(); }, [this] { return GetLabelText(); },
                          [this] { Click(); }});
}

ZelStaticBitmap::~ZelStaticBitmap()
{
    ForgetButton(this);
    if (HasCapture())
        ReleaseMouse();
}

void ZelStaticBitmap::Invalidate()
{
    m_dirty = true;
    Refresh(true);
}

void ZelStaticBitmap::DeriveDisabledBitmap()
{
    if (!m_customDisabled)
        m_bitmapDisabled = MakeDisabledBitmap(m_bitmap, GetBackgroundColour(), 0.5);
}

void ZelStaticBitmap::SetFramed(bool framed)
{
    if (framed == m_framed)
        return;
    m_framed = framed;
    SetBitmap(m_bitmap);
}

bool ZelStaticBitmap::IsFramed() const
{
    return m_framed;
}

wxBitmap ZelStaticBitmap::GetBitmap() const
{
    return m_bitmap;
}

wxBitmap ZelStaticBitmap::GetBitmapHover() const
{
    return m_bitmapHover;
}

wxBitmap ZelStaticBitmap::GetBitmapPressed() const
{
    return m_bitmapPressed;
}

wxBitmap ZelStaticBitmap::GetBitmapToggled() const
{
    return m_bitmapToggled;
}

wxBitmap ZelStaticBitmap::GetBitmapDisabled() const
{
    return m_bitmapDisabled;
}

void ZelStaticBitmap::SetBitmap(const wxBitmap& bitmap)
{
    m_bitmap = bitmap;
    DeriveDisabledBitmap();
    InvalidateBestSize();
    Invalidate();
}

void ZelStaticBitmap::SetBitmapHover(const wxBitmap& bitmap)
{
    m_bitmapHover = bitmap;
    InvalidateBestSize();
    if (m_state == STATE_HOVER)
        Invalidate();
}

void ZelStaticBitmap::SetBitmapPressed(const wxBitmap& bitmap)
{
    m_bitmapPressed = bitmap;
    InvalidateBestSize();
    if (m_state == STATE_PRESSED)
        Invalidate();
}

void ZelStaticBitmap::SetBitmapToggled(const wxBitmap& bitmap)
{
    m_bitmapToggled = bitmap;
    InvalidateBestSize();
    if (m_toggled)
        Invalidate();
}

void ZelStaticBitmap::SetBitmapDisabled(const wxBitmap& bitmap)
{
    m_customDisabled = true;
    m_bitmapDisabled = bitmap;
    InvalidateBestSize();
    if (m_state == STATE_NORMAL && !IsEnabled())
        Invalidate();
}

void ZelStaticBitmap::SetToggled(bool toggled)
{
    if (toggled == m_toggled)
        return;
    m_toggled = toggled;
    Invalidate();
}

bool ZelStaticBitmap::IsToggled() const
{
    return m_toggled;
}

bool ZelStaticBitmap::Enable(bool enable)
{
    // A disabled button sees no release, so it must not keep the mouse.
    if (!enable && HasCapture()) {
        ReleaseMouse();
        m_state = STATE_NORMAL;
    }
    const bool changed = wxControl::Enable(enable);
    Invalidate();
    return changed;
}

bool ZelStaticBitmap::Disable()
{
    return Enable(false);
}

bool ZelStaticBitmap::SetCentred(bool centred)
{
    m_centred = centred;
    Invalidate();
    return m_centred;
}

bool ZelStaticBitmap::SetBackgroundColour(const wxColour& colour)
{
    const bool changed = wxControl::SetBackgroundColour(colour);
    DeriveDisabledBitmap();
    Invalidate();
    return changed;
}

wxSize ZelStaticBitmap::DoGetBestSize() const
{
    wxSize best(0, 0);
    for (const wxBitmap* b : {&m_bitmap, &m_bitmapDisabled, &m_bitmapHover, &m_bitmapPressed})
        if (b->IsOk())
            best.IncTo(b->GetLogicalSize());
    if (m_framed)
        best += FromDIP(wxSize(4, 6));
    return best;
}

const wxBitmap& ZelStaticBitmap::ShownForState(int state) const
{
    if (state == STATE_PRESSED && m_bitmapPressed.IsOk())
        return m_bitmapPressed;
    if (state != STATE_NORMAL && m_bitmapHover.IsOk())
        return m_bitmapHover;
    return m_bitmap;
}

void ZelStaticBitmap::Click()
{
    wxCommandEvent click(wxEVT_BUTTON, GetId());
    InitCommandEvent(click);
    Command(click);
}

void ZelStaticBitmap::OnMouse(wxMouseEvent& event)
{
    const int s = m_state;
    int n = s;
    const wxPoint p = ScreenToClient(wxGetMousePosition());
    const wxSize size = GetClientSize();
    const bool inside = p.x >= 0 && p.y >= 0 && p.x < size.x && p.y < size.y;

    if (!IsEnabled()) {
        if (event.Leaving())
            n = STATE_NORMAL;
    } else if (event.Entering()) {
        n = event.LeftIsDown() && HasCapture() ? STATE_PRESSED : STATE_HOVER;
    } else if (event.Leaving()) {
        n = STATE_NORMAL;
    } else if (event.LeftDown()) {
        if (!HasCapture())
            CaptureMouse();
        n = STATE_PRESSED;
    } else if (event.LeftUp()) {
        if (HasCapture())
            ReleaseMouse();
        // GTK may hand over the release before the motion that left the
        // control: a release outside never clicks.
        if (s == STATE_PRESSED && inside)
            Click();
        n = inside ? STATE_HOVER : STATE_NORMAL;
    } else if (event.LeftDClick()) {
        Click();
        n = STATE_HOVER;
    } else if (event.LeftIsDown() && HasCapture()) {
        if (inside && s == STATE_NORMAL)
            n = STATE_PRESSED;
        else if (!inside && s != STATE_NORMAL)
            n = STATE_NORMAL;
    } else if (event.Moving() && inside && s == STATE_NORMAL) {
        // GTK reports no enter that comes with the end of another window's grab (a
        // click on a neighbour just before): the first motion over the button shows it.
        n = STATE_HOVER;
    }

    if (n != s) {
        m_state = n;
        if (m_framed || !ShownForState(n).IsSameAs(ShownForState(s)))
            Invalidate();
    }
    event.Skip();
}

void ZelStaticBitmap::OnCaptureLost(wxMouseCaptureLostEvent&)
{
    // The toolkit broke the grab (window hidden, another grab): no click.
    m_state = STATE_NORMAL;
    Invalidate();
}

void ZelStaticBitmap::OnPaint(wxPaintEvent&)
{
    wxPaintDC dc(this);
    if (!IsShown())
        return;
    const wxSize size = GetClientSize();
    if (size.x <= 0 || size.y <= 0)
        return;
    // Of the display's physical pixels, so that a scaled display shows the images' own.
    const double scale = PictureScale(*this);
    const wxSize dipSize = ToDIP(size);
    if (!m_backBuffer || !m_backBuffer->IsOk() || m_backBuffer->GetDIPSize() != dipSize ||
        m_backBuffer->GetScaleFactor() != scale) {
        m_backBuffer = std::make_unique<wxBitmap>();
        m_backBuffer->CreateWithDIPSize(dipSize, scale);
        m_dirty = true;
    }
    if (m_dirty) {
        wxMemoryDC mem(*m_backBuffer);
        Render(mem, size.x, size.y);
        m_dirty = false;
    }
    dc.DrawBitmap(*m_backBuffer, 0, 0, false);
    // Over the buffer, so that the looks stay as they are without the focus.
    if (HasFocus() && IsFocusShown(this))
        DrawFocusMark(dc, size.x, size.y);
}

void ZelStaticBitmap::Render(wxDC& dc, int w, int h)
{
    const wxBitmap* image = &m_bitmap;
    bool frame = m_framed;
    bool sunken = m_toggled && m_framed;
    if (!IsEnabled()) {
        if (m_bitmapDisabled.IsOk()) {
            image = &m_bitmapDisabled;
            frame = false;
        }
    } else if (sunken) {
        if (m_bitmapToggled.IsOk()) {
            image = &m_bitmapToggled;
            frame = false;
        } else if (m_bitmapPressed.IsOk()) {
            image = &m_bitmapPressed;
            frame = false;
        }
    } else if (m_state == STATE_HOVER) {
        if (m_bitmapHover.IsOk()) {
            image = &m_bitmapHover;
            frame = false;
        }
    } else if (m_state == STATE_PRESSED) {
        if (m_bitmapPressed.IsOk() || m_bitmapHover.IsOk()) {
            image = m_bitmapPressed.IsOk() ? &m_bitmapPressed : &m_bitmapHover;
            frame = false;
        }
        sunken = true;
    } else {
        frame = false;
    }

    dc.SetBackground(wxBrush(GetBackgroundColour(), wxBRUSHSTYLE_SOLID));
    dc.Clear();

    wxColour outer, inner;
    if (frame) {
        wxColour top, bottom;
        if (sunken && m_toggled) {
            top = bottom = SysColour(wxSYS_COLOUR_BTNHIGHLIGHT);
            outer = SysColour(wxSYS_COLOUR_3DDKSHADOW);
            inner = SysColour(wxSYS_COLOUR_3DLIGHT);
        } else if (sunken) {
            top = bottom = SysColour(wxSYS_COLOUR_BTNSHADOW);
            outer = SysColour(wxSYS_COLOUR_3DDKSHADOW);
            inner = SysColour(wxSYS_COLOUR_BTNFACE);
        } else {
            top = SysColour(wxSYS_COLOUR_BTNHIGHLIGHT);
            bottom = SysColour(wxSYS_COLOUR_ACTIVEBORDER);
            outer = SysColour(wxSYS_COLOUR_BTNSHADOW);
            inner = SysColour(wxSYS_COLOUR_3DDKSHADOW);
        }
        DrawFrameFill(dc, w, h, top, bottom);
    }

    const wxSize imageSize = image->IsOk() ? image->GetLogicalSize() : wxSize();
    if (imageSize.x > 0 && imageSize.y > 0) {
        if (m_centred)
            dc.DrawBitmap(*image, (w - imageSize.x) / 2, (h - imageSize.y) / 2, true);
        else
            dc.DrawBitmap(*image, FromDIP(2), FromDIP(3), true);
    }

    if (frame)
        DrawFrameEdges(dc, w, h, outer, inner);
}

void ZelStaticBitmap::DrawFrameFill(wxDC& dc, int w, int h, const wxColour& top,
                                    const wxColour& bottom)
{
    dc.SetBrush(wxBrush(top, wxBRUSHSTYLE_SOLID));
    SetPenColour(dc, GetBackgroundColour());
    dc.DrawRoundedRectangle(0, 0, w, h, 4.0);
    // Each row of the gradient stops where the rounded corners begin.
    for (int y = 1; y <= h - 2; ++y) {
        const float r = static_cast<float>(y) / h;
        SetPenColour(dc, Mix(top, bottom, r * r));
        const int x0 = y == 1 ? 3 : y == 2 ? 2 : y == h - 3 ? 2 : y == h - 2 ? 3 : 1;
        dc.DrawLine(x0, y, w - x0, y);
    }
}

void ZelStaticBitmap::DrawFrameEdges(wxDC& dc, int w, int h, const wxColour& outer,
                                     const wxColour& inner)
{
    SetPenColour(dc, outer);
    dc.DrawLine(3, 0, w - 3, 0);
    int k = 2;
    for (int y = 1; y <= h - 2; ++y, --k) {
        int x = 0;
        float a = 0.0f, b = 1.0f;
        if (y < 3) {
            x = k;
            b = 1.0f - 0.25f * k;
        } else if (y > h - 4) {
            x = y - h + 4;
            a = 0.25f * x;
        }
        SetPenColour(dc, Mix(outer, inner, a));
        dc.DrawPoint(x, y);
        SetPenColour(dc, Mix(outer, inner, b));
        dc.DrawPoint(w - x - 1, y);
    }
    SetPenColour(dc, inner);
    dc.DrawLine(3, h - 1, w - 3, h - 1);

    const wxColour bg = GetBackgroundColour();
    const wxColour middle = Mix(outer, inner, 0.5f);
    SetPenColour(dc, Mix(bg, middle, 0.5f));
    dc.DrawPoint(w - 2, 1);
    dc.DrawPoint(1, h - 2);
    SetPenColour(dc, Mix(bg, outer, 0.5f));
    dc.DrawPoint(1, 1);
    SetPenColour(dc, Mix(bg, inner, 0.5f));
    dc.DrawPoint(w - 2, h - 2);
}

void ZelStaticBitmap::OnEraseBackground(wxEraseEvent&) {}

void ZelStaticBitmap::OnMove(wxMoveEvent& event)
{
    event.Skip();
}

void ZelStaticBitmap::DrawFocusMark(wxDC& dc, int w, int h)
{
    dc.SetPen(wxPen(SysColour(wxSYS_COLOUR_HIGHLIGHT), 2, wxPENSTYLE_SOLID));
    dc.SetBrush(*wxTRANSPARENT_BRUSH);
    dc.DrawRoundedRectangle(1, 1, w - 2, h - 2, 4.0);
}

void ZelStaticBitmap::OnKillFocus(wxFocusEvent& event)
{
    Refresh(false);
    event.Skip();
}

void ZelStaticBitmap::OnSetFocus(wxFocusEvent& event)
{
    Refresh(false);
    event.Skip();
}

void ZelStaticBitmap::SetFocusable(bool focusable)
{
    m_focusable = focusable;
    // GTK took the first answer when the window was made.
    SetCanFocus(focusable);
}

void ZelStaticBitmap::OnKeyDown(wxKeyEvent& event)
{
    switch (event.GetKeyCode()) {
    case WXK_SPACE:
    case WXK_RETURN:
    case WXK_NUMPAD_SPACE:
    case WXK_NUMPAD_ENTER:
        if (IsEnabled())
            Click();
        break;
    default:
        event.Skip();
    }
}

void ZelStaticBitmap::OnWindowCreate(wxWindowCreateEvent& event)
{
    if (event.GetWindow() == this)
        DropInputMethod(this);
    event.Skip();
}

void ZelStaticBitmap::OnSysColourChanged(wxSysColourChangedEvent& event)
{
    DeriveDisabledBitmap();
    Invalidate();
    event.Skip();
}

wxBitmap MakeDisabledBitmap(const wxBitmap& bitmap, const wxColour& colour, double factor)
{
    if (!bitmap.IsOk() || bitmap.GetWidth() <= 0 || bitmap.GetHeight() <= 0)
        return wxBitmap();
    wxImage source = bitmap.ConvertToImage();
    if (!source.IsOk())
        return wxBitmap();
    // Pictures whose alpha is only 0 or 255 may carry a mask instead.
    if (source.HasMask())
        source.InitAlpha();
    const int k = static_cast<int>(std::clamp(factor, 0.0, 1.0) * 256 + 0.5);
    const int w = source.GetWidth(), h = source.GetHeight();
    wxImage result(w, h, false);
    const unsigned char* from = source.GetData();
    unsigned char* to = result.GetData();
    const unsigned char blend[3] = {colour.Red(), colour.Green(), colour.Blue()};
    for (long i = 0; i < 3L * w * h; ++i)
        to[i] = static_cast<unsigned char>((from[i] * k + blend[i % 3] * (256 - k)) >> 8);
    if (source.HasAlpha()) {
        result.InitAlpha();
        std::copy(source.GetAlpha(), source.GetAlpha() + static_cast<long>(w) * h,
                  result.GetAlpha());
    }
    return ScaledBitmap(result, bitmap.GetScaleFactor());
}
