#include "about/ModuleSplash.h"

#include "about/PictureWindow.h"
#include "controls/TextBitmap.h"
#include "platform/DisplayScale.h"
#include "resources/ImageSets.h"

#include <wx/dcclient.h>
#include <wx/frame.h>
#include <wx/utils.h>

namespace {

const int kTextLeft = 140;
const int kFirstLineTop = -10;
const int kLineStep = 15;
const int kBoldLines = 3;
const int kPointSize = 8;

} // namespace

// clang-format off
wxBEGIN_EVENT_TABLE(ZelModuleSplashScreen, wxDialog)
    EVT_CLOSE(ZelModuleSplashScreen::OnCloseWindow)
    EVT_MOUSE_EVENTS(ZelModuleSplashScreen::OnMouseEvent)
    EVT_MOUSE_CAPTURE_LOST(ZelModuleSplashScreen::OnCaptureLost)
    EVT_KILL_FOCUS(ZelModuleSplashScreen::OnKeyOrFocusLoss)
    EVT_ACTIVATE(ZelModuleSplashScreen::OnDeactivate)
    EVT_ACTIVATE_APP(ZelModuleSplashScreen::OnDeactivate)
    EVT_CHAR(ZelModuleSplashScreen::OnKeyOrFocusLoss)
    EVT_PAINT(ZelModuleSplashScreen::OnPaint)
wxEND_EVENT_TABLE()
// clang-format on

wxBitmap LoadCommonBitmap(const wxString& name, double scale)
{
    EnsureCommonImages();
    return LoadPicture(name, scale);
}

ZelModuleSplashScreen::ZelModuleSplashScreen(int id, const wxArrayString& lines)
{
    wxDialog::Create(nullptr, id, wxString(), wxDefaultPosition, wxDefaultSize,
                     wxNO_BORDER | wxSTAY_ON_TOP | wxFRAME_SHAPED | wxFRAME_NO_TASKBAR);
    m_lines = lines;
    m_picture = LoadCommonBitmap("Helper::ModuleSplash", PictureScale(*this));
    wxSafeYield(nullptr, false);

    const wxSize size = m_picture.IsOk() ? m_picture.GetLogicalSize() : wxSize(0, 0);
    SetClientSize(size);
    CentreOnPrimaryDisplay(this, size);
    SetWindowStyle(wxFRAME_SHAPED);
    ShapeToPicture(this, m_picture);

    // Without children the window itself must take the keyboard focus, or keys never reach it.
    SetCanFocus(true);
    SetFocus();
    Show(true);
    Update();
    Raise();
    if (!HasCapture())
        CaptureMouse();
}

ZelModuleSplashScreen::~ZelModuleSplashScreen()
{
    Hide();
    if (HasCapture())
        ReleaseMouse();
}

void ZelModuleSplashScreen::OnCloseWindow(wxCloseEvent&)
{
    if (HasCapture())
        ReleaseMouse();
    Destroy();
}

void ZelModuleSplashScreen::OnMouseEvent(wxMouseEvent& event)
{
    if (event.ButtonDown(wxMOUSE_BTN_ANY))
        Close(false);
    event.Skip();
}

void ZelModuleSplashScreen::OnCaptureLost(wxMouseCaptureLostEvent&)
{
    // Another program took the pointer: the window could no longer see the click that closes it.
    Close(false);
}

void ZelModuleSplashScreen::OnKeyOrFocusLoss(wxFocusEvent& event)
{
    Close(false);
    event.Skip();
}

void ZelModuleSplashScreen::OnKeyOrFocusLoss(wxKeyEvent& event)
{
    Close(false);
    event.Skip();
}

void ZelModuleSplashScreen::OnDeactivate(wxActivateEvent& event)
{
    if (!event.GetActive())
        Close(false);
    event.Skip();
}

void ZelModuleSplashScreen::OnPaint(wxPaintEvent&)
{
    wxPaintDC dc(this);
    if (m_picture.IsOk())
        dc.DrawBitmap(m_picture, 0, 0, true);
    dc.SetTextForeground(DarkOnPicture(dc.GetTextForeground()));
    dc.SetFont(GetUIFont(kPointSize, wxFONTWEIGHT_BOLD));
    for (size_t i = 0; i < m_lines.size(); ++i) {
        if (i == kBoldLines)
            dc.SetFont(GetUIFont(kPointSize, wxFONTWEIGHT_NORMAL));
        if (!m_lines[i].empty())
            dc.DrawText(m_lines[i], kTextLeft, kFirstLineTop + kLineStep * int(i));
    }
}
