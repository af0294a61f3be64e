// The launcher's image button: a borderless control that shows one of five
// images by state (normal, hover, pressed, toggled, disabled), follows the
// mouse with capture and sends a button-click command event like a native
// button. It takes the keyboard focus (Space and Return click it, a mark
// shows the focus once the keyboard is used) and, given a label, answers
// screen readers as a push button named by it; an optional framed look draws
// a rounded bevel behind the image.
#pragma once

#include <wx/bitmap.h>
#include <wx/control.h>

#include <memory>

// Style of ZelStaticBitmap: the framed look.
constexpr long ZSB_FRAMED = 4;

class ZelStaticBitmap : public wxControl
{
public:
    enum State
    {
        STATE_NORMAL = 0,
        STATE_HOVER = 1,
        STATE_PRESSED = 2
    };

    ZelStaticBitmap(wxWindow* parent, wxWindowID id, const wxBitmap& bitmap,
                    const wxPoint& pos = wxDefaultPosition, const wxSize& size = wxDefaultSize,
                    long style = 0, const wxString& name = "zelStaticBitmap");
    ~ZelStaticBitmap() override;

    virtual void SetFramed(bool framed);
    virtual bool IsFramed() const;
    virtual wxBitmap GetBitmap() const;
    virtual wxBitmap GetBitmapHover() const;
    virtual wxBitmap GetBitmapPressed() const;
    virtual wxBitmap GetBitmapToggled() const;
    virtual wxBitmap GetBitmapDisabled() const;
    virtual void SetBitmap(const wxBitmap& bitmap);
    virtual void SetBitmapHover(const wxBitmap& bitmap);
    virtual void SetBitmapPressed(const wxBitmap& bitmap);
    virtual void SetBitmapToggled(const wxBitmap& bitmap);
    virtual void SetBitmapDisabled(const wxBitmap& bitmap);
    virtual void SetToggled(bool toggled);
    virtual bool IsToggled() const;
    virtual bool Disable();
    virtual bool SetCentred(bool centred);
    // A picture that is no button takes the keyboard focus neither from the
    // keyboard nor when a dialog is shown.
    void SetFocusable(bool focusable);
    bool AcceptsFocus() const override { return m_focusable; }

    virtual void OnSysColourChanged(wxSysColourChangedEvent& event);
    virtual void OnEraseBackground(wxEraseEvent& event);
    virtual void OnMove(wxMoveEvent& event);
    virtual void OnPaint(wxPaintEvent& event);
    virtual void OnMouse(wxMouseEvent& event);
    virtual void OnKillFocus(wxFocusEvent& event);
    virtual void OnSetFocus(wxFocusEvent& event);
    virtual void OnKeyDown(wxKeyEvent& event);
    virtual void OnCaptureLost(wxMouseCaptureLostEvent& event);
    virtual void OnWindowCreate(wxWindowCreateEvent& event);

    bool Enable(bool enable = true) override;
    bool SetBackgroundColour(const wxColour& colour) override;

    // 0 normal, 1 hover (pointer over it), 2 pressed (left button held on it).
    int GetState() const { return m_state; }

    // Sends the button-click command event, as a click with the mouse does.
    void Click();

protected:
    wxSize DoGetBestSize() const override;

private:
    void Invalidate();
    void DeriveDisabledBitmap();
    const wxBitmap& ShownForState(int state) const;
    void Render(wxDC& dc, int w, int h);
    void DrawFrameFill(wxDC& dc, int w, int h, const wxColour& top, const wxColour& bottom);
    void DrawFrameEdges(wxDC& dc, int w, int h, const wxColour& outer, const wxColour& inner);
    void DrawFocusMark(wxDC& dc, int w, int h);

    wxBitmap m_bitmap;
    wxBitmap m_bitmapHover;
    wxBitmap m_bitmapPressed;
    wxBitmap m_bitmapToggled;
    wxBitmap m_bitmapDisabled;
    std::unique_ptr<wxBitmap> m_backBuffer;
    bool m_customDisabled = false;
    bool m_dirty = true;
    bool m_toggled = false;
    bool m_framed = false;
    bool m_centred = true;
    bool m_focusable = true;
    int m_state = STATE_NORMAL;

    wxDECLARE_EVENT_TABLE();
};

// The image blended toward `colour`: factor 1 keeps the image, 0 gives the
// colour; alpha is kept. Invalid for an invalid image.
wxBitmap MakeDisabledBitmap(const wxBitmap& bitmap, const wxColour& colour, double factor);
