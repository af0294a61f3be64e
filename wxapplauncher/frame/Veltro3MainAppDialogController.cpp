#include "frame/Veltro3MainAppDialogController.h"

#include "controls/TextBitmap.h"
#include "platform/DisplayScale.h"
#include "platform/KeyboardFocus.h"
#include "resources/ImageSets.h"

#include <wx/dcclient.h>
#include <wx/dcmemory.h>
#include <wx/settings.h>

namespace {
// The launcher picture is laid out for exactly this client size.
const wxSize kViewSize(564, 344);
const wxPoint kCreateTitle(250, 25);
const wxPoint kEvaluateTitle(418, 25);
// Each title stays above its column of buttons, which ends here.
const int kCreateColumnRight = 380;
const int kEvaluateColumnRight = 557;

// One size for both titles, the largest at which each fits its column: large
// desktop text would otherwise run "Evaluate Profile" into the window's edge.
wxFont TitleFont(double scale)
{
    const wxFont font = GetUIFont(8, wxBOLD);
    auto fit = [&font, scale](const wxString& title, int room) {
        wxArrayString lines;
        lines.Add(title);
        return FitFontToWidth(font, lines, room, scale);
    };
    const wxFont create = fit(_("Create Profile"), kCreateColumnRight - kCreateTitle.x);
    const wxFont evaluate = fit(_("Evaluate Profile"), kEvaluateColumnRight - kEvaluateTitle.x);
    return create.GetPointSize() < evaluate.GetPointSize() ? create : evaluate;
}
} // namespace

// clang-format off
wxBEGIN_EVENT_TABLE(Veltro3MainAppDialogController, wxPanel)
    EVT_SYS_COLOUR_CHANGED(Veltro3MainAppDialogController::OnSysColourChanged)
    EVT_PAINT(Veltro3MainAppDialogController::OnPaint)
    EVT_ERASE_BACKGROUND(Veltro3MainAppDialogController::OnEraseBackground)
    EVT_WINDOW_CREATE(Veltro3MainAppDialogController::OnWindowCreate)
wxEND_EVENT_TABLE()
// clang-format on

bool IsUsablePicture(const wxBitmap& bitmap)
{
    return bitmap.IsOk() && bitmap.GetWidth() > 0 && bitmap.GetHeight() > 0;
}

Veltro3MainAppDialogController::Veltro3MainAppDialogController(wxWindow* parent, wxWindowID id,
                                                               const wxPoint& pos,
                                                               const wxSize& size, long style,
                                                               const wxString& name)
    : wxPanel(parent, id, pos, size, style, name)
{
    ResetViewColour();
    const double scale = PictureScale(*this);
    m_background = LoadPicture("Veltro2AppFrame::LauncherBG", scale);
    // Drawn, the picture would keep its decoded pixels twice: as loaded and as the
    // toolkit's drawing surface. Selected once, only the surface stays.
    if (IsUsablePicture(m_background))
        wxMemoryDC(m_background).SelectObject(wxNullBitmap);
    m_titleFont = TitleFont(scale);
    SetInitialSize(size);
}

Veltro3MainAppDialogController::~Veltro3MainAppDialogController() = default;

void Veltro3MainAppDialogController::ResetViewColour()
{
    m_viewColour = wxColour(224, 223, 227, 255);
}

void Veltro3MainAppDialogController::UpdateModuleButtons() {}

void Veltro3MainAppDialogController::DrawContent(wxDC&) {}

void Veltro3MainAppDialogController::Refresh(bool eraseBackground, const wxRect* rect)
{
    m_dirty = true;
    wxPanel::Refresh(eraseBackground, rect);
}

void Veltro3MainAppDialogController::OnWindowCreate(wxWindowCreateEvent& event)
{
    if (event.GetWindow() == this)
        DropInputMethod(this);
    event.Skip();
}

wxSize Veltro3MainAppDialogController::DoGetBestSize() const
{
    return FromDIP(kViewSize);
}

void Veltro3MainAppDialogController::OnPaint(wxPaintEvent&)
{
    wxPaintDC dc(this);
    const wxSize size = GetClientSize();
    if (size.x <= 0 || size.y <= 0)
        return;
    // Of the display's physical pixels: a scaled display shows the pictures' own pixels
    // and text drawn at its resolution.
    const double scale = PictureScale(*this);
    const wxSize dipSize = ToDIP(size);
    if (!m_backBuffer.IsOk() || m_backBuffer.GetDIPSize() != dipSize ||
        m_backBuffer.GetScaleFactor() != scale) {
        m_backBuffer = wxBitmap();
        m_backBuffer.CreateWithDIPSize(dipSize, scale);
        m_dirty = true;
    }
    if (!m_backBuffer.IsOk())
        return;
    if (m_dirty) {
        wxMemoryDC memory(m_backBuffer);
        DrawBackground(memory);
        DrawContent(memory);
        memory.SelectObject(wxNullBitmap);
        m_dirty = false;
    }
    dc.DrawBitmap(m_backBuffer, 0, 0, false);
}

void Veltro3MainAppDialogController::DrawBackground(wxDC& dc)
{
    dc.SetBackground(wxBrush(GetBackgroundColour(), wxBRUSHSTYLE_SOLID));
    dc.Clear();
    if (IsUsablePicture(m_background))
        dc.DrawBitmap(m_background, 0, 0, true);

    dc.SetFont(m_titleFont);
    dc.SetTextForeground(DarkOnPicture(dc.GetTextForeground()));
    dc.DrawText(_("Create Profile"), FromDIP(kCreateTitle));
    dc.DrawText(_("Evaluate Profile"), FromDIP(kEvaluateTitle));

    // A sunken rule under the menu bar.
    const int width = GetClientSize().x;
    const int line = FromDIP(1);
    dc.SetPen(wxPen(wxSystemSettings::GetColour(wxSYS_COLOUR_BTNSHADOW), line, wxPENSTYLE_SOLID));
    dc.DrawLine(0, 0, width, 0);
    dc.SetPen(
        wxPen(wxSystemSettings::GetColour(wxSYS_COLOUR_BTNHIGHLIGHT), line, wxPENSTYLE_SOLID));
    dc.DrawLine(0, line, width, line);
}

void Veltro3MainAppDialogController::OnEraseBackground(wxEraseEvent&) {}

void Veltro3MainAppDialogController::OnSysColourChanged(wxSysColourChangedEvent& event)
{
    ResetViewColour();
    Refresh(true);
    event.Skip();
}
