#include "frame/Veltro3MainAppStandardView.h"

#include "controls/TextBitmap.h"
#include "controls/ZelStaticBitmap.h"
#include "frame/DragNDrop.h"
#include "frame/Ids.h"
#include "frame/ModuleCatalog.h"
#include "platform/DisplayScale.h"
#include "resources/ImageSets.h"

#include <wx/app.h>
#include <wx/frame.h>
#include <wx/menu.h>
#include <wx/utils.h>

namespace {

struct ButtonPlace
{
    int moduleId;
    const char* icon; // picture name without its "Veltro2AppFrame::" prefix
    int left;
    int row; // 0 top, 1 middle, 2 bottom
};

// In the order of the view's image and button arrays.
const ButtonPlace kPlaces[] = {
    {ID_MODULE_MONITOR, "MonitorModule", 228, 1},
    {ID_MODULE_PRINTER, "PrinterModule", 228, 0},
    {ID_MODULE_DEVICELINK, "LinkStudioModule", 228, 2},
    {ID_MODULE_VERIFY, "VerifierModule", 405, 2},
    {ID_MODULE_INSPECT, "InspectorModule", 405, 0},
    {ID_MODULE_EDIT, "EditModule", 405, 1},
};

// The size of the highlight pictures, used when they are missing.
const wxSize kButtonSize(152, 58);
const wxColour kHelpButtonColour(218, 217, 221);
// Labels start this far right of the icon's width.
const int kLabelGap = 16;
const int kIconWidth = 48;

} // namespace

// clang-format off
wxBEGIN_EVENT_TABLE(Veltro3MainAppStandardView, Veltro3MainAppDialogController)
    EVT_BUTTON(ID_BUTTON_MONITOR, Veltro3MainAppStandardView::OnLaunchMonitor)
    EVT_BUTTON(ID_BUTTON_PRINTER, Veltro3MainAppStandardView::OnLaunchPrinter)
    EVT_BUTTON(ID_BUTTON_DEVICELINK, Veltro3MainAppStandardView::OnLaunchDeviceLink)
    EVT_BUTTON(ID_BUTTON_EDIT, Veltro3MainAppStandardView::OnLaunchEdit)
    EVT_BUTTON(ID_BUTTON_INSPECT, Veltro3MainAppStandardView::OnLaunchInspect)
    EVT_BUTTON(ID_BUTTON_VERIFY, Veltro3MainAppStandardView::OnLaunchVerify)
wxEND_EVENT_TABLE()
// clang-format on

Veltro3MainAppStandardView::Veltro3MainAppStandardView(wxWindow* parent, wxWindowID id,
                                                       const wxPoint& pos, const wxSize& size,
                                                       long style, const wxString& name)
    : Veltro3MainAppDialogController(parent, id, pos, size, style, name)
{
    const double scale = PictureScale(*this);
    auto Picture = [scale](const wxString& name) {
        return LoadPicture("Veltro2AppFrame::" + name, scale);
    };
    const wxCursor hand(wxCURSOR_HAND);
    const wxBitmap highlight = Picture("HighlightBackground");
    const wxBitmap highlightPressed = Picture("HighlightPressed");
    const wxSize canvasSize = IsUsablePicture(highlight) ? highlight.GetDIPSize() : kButtonSize;
    const wxBitmap blank = DrawTextToBitmap(canvasSize, wxDefaultPosition, GetFont(), wxString(),
                                            *wxBLACK, 0, 0, scale);
    const int middle = (369 - canvasSize.y) / 2;
    const int rowTops[] = {middle - 87, middle, middle + 82};

    // One size for all labels, the largest at which the longest fits: large desktop
    // text must not shrink one label alone.
    wxArrayString labels;
    for (const ButtonPlace& place : kPlaces)
        labels.Add(wxGetTranslation(FindModule(place.moduleId)->buttonLabel));
    m_labelFont = FitFontToWidth(GetFont(), labels, canvasSize.x - kIconWidth - kLabelGap, scale);

    for (int i = 0; i < MODULE_COUNT; ++i) {
        const ButtonPlace& place = kPlaces[i];
        const ModuleInfo* module = FindModule(place.moduleId);
        const wxString label = wxGetTranslation(module->buttonLabel);
        const wxString icon = place.icon;
        m_images[i].normal = ComposeButtonImage(blank, Picture(icon), label, wxPoint(0, 0));
        m_images[i].hover = ComposeButtonImage(IsUsablePicture(highlight) ? highlight : blank,
                                               Picture(icon + "Active"), label, wxPoint(0, 0));
        m_images[i].pressed =
            ComposeButtonImage(IsUsablePicture(highlightPressed) ? highlightPressed : blank,
                               Picture(icon + "Selected"), label, wxPoint(-1, 0));

        m_buttons[i] = new ZelStaticBitmap(this, module->buttonId, m_images[i].normal,
                                           FromDIP(wxPoint(place.left, rowTops[place.row])),
                                           wxDefaultSize, wxNO_BORDER, "zelStaticBitmap");
        m_buttons[i]->SetLabel(label);
        m_buttons[i]->SetCursor(hand);
        if (i == MONITOR || i == VERIFY || i == EDIT)
            m_buttons[i]->SetBackgroundColour(GetViewColour());
        // Only the Inspect button takes dropped files.
        if (i == INSPECT)
            m_buttons[i]->SetDropTarget(new DragNDrop(this, ID_MODULE_INSPECT));
    }

    m_helpButton = new ZelStaticBitmap(this, ID_BUTTON_HELP, Picture("Help"),
                                       wxPoint(FromDIP(10), GetSize().y - FromDIP(40)),
                                       wxDefaultSize, ZSB_FRAMED, "zelStaticBitmap");
    m_helpButton->SetBackgroundColour(kHelpButtonColour);
    m_helpButton->SetLabel(wxStripMenuCodes(_("&Help")));

    // Tab goes down the left column, then the right one, then to Help.
    ZelStaticBitmap* previous = m_buttons[PRINTER];
    for (ZelStaticBitmap* next : {m_buttons[MONITOR], m_buttons[DEVICELINK], m_buttons[INSPECT],
                                  m_buttons[EDIT], m_buttons[VERIFY], m_helpButton}) {
        next->MoveAfterInTabOrder(previous);
        previous = next;
    }

    UpdateModuleButtons();
}

Veltro3MainAppStandardView::~Veltro3MainAppStandardView() = default;

wxBitmap Veltro3MainAppStandardView::ComposeButtonImage(const wxBitmap& canvas,
                                                        const wxBitmap& icon, const wxString& label,
                                                        const wxPoint& offset)
{
    if (!IsUsablePicture(canvas))
        return canvas;
    const int iconWidth = IsUsablePicture(icon) ? icon.GetDIPSize().x : 0;
    const wxSize size = canvas.GetDIPSize();
    // The pictures are light: a dark theme's light text colour would vanish.
    const wxBitmap text = DrawTextToBitmap(
        size, wxPoint(offset.x + iconWidth + kLabelGap, size.y / 2 + offset.y),
        m_labelFont.IsOk() ? m_labelFont : GetFont(), label, DarkOnPicture(GetForegroundColour()),
        wxALIGN_CENTER_VERTICAL, 0, canvas.GetScaleFactor());
    wxBitmap image = IsUsablePicture(icon) ? CompositeBitmap(canvas, icon, wxPoint(6, 2)) : canvas;
    if (text.IsOk())
        image = CompositeBitmap(image, text, wxPoint(0, 0));
    return image;
}

void Veltro3MainAppStandardView::UpdateModuleButtons()
{
    auto* frame = wxDynamicCast(wxTheApp ? wxTheApp->GetTopWindow() : nullptr, wxFrame);
    if (wxMenuBar* menuBar = frame ? frame->GetMenuBar() : nullptr) {
        for (int command : {ID_MODULE_PRINTER, ID_MODULE_DEVICELINK, ID_MODULE_INSPECT,
                            ID_MODULE_EDIT, ID_MODULE_MONITOR, ID_MODULE_VERIFY})
            if (wxMenuItem* item = menuBar->FindItem(command))
                item->Enable(true);
    }

    const wxCursor hand(wxCURSOR_HAND);
    for (int i = 0; i < MODULE_COUNT; ++i) {
        ZelStaticBitmap* button = m_buttons[i];
        if (!button)
            continue;
        button->SetBitmap(m_images[i].normal);
        button->SetBitmapHover(m_images[i].hover);
        button->SetBitmapPressed(m_images[i].pressed);
        if (i != MONITOR)
            button->SetBackgroundColour(GetViewColour());
        if (i == MONITOR || i == VERIFY) {
            button->SetCursor(hand);
            button->Enable(true);
        }
    }
    Update();
}

void Veltro3MainAppStandardView::OnSysColourChanged(wxSysColourChangedEvent& event)
{
    ResetViewColour();
    for (int i : {INSPECT, EDIT})
        if (m_buttons[i])
            m_buttons[i]->SetBackgroundColour(GetViewColour());
    Refresh(true);
    event.Skip();
}

void Veltro3MainAppStandardView::OnLaunchPrinter(wxCommandEvent&)
{
    LaunchModule(ID_MODULE_PRINTER, wxString());
}

void Veltro3MainAppStandardView::OnLaunchMonitor(wxCommandEvent&)
{
    LaunchModule(ID_MODULE_MONITOR, wxString());
}

void Veltro3MainAppStandardView::OnLaunchDeviceLink(wxCommandEvent&)
{
    LaunchModule(ID_MODULE_DEVICELINK, wxString());
}

void Veltro3MainAppStandardView::OnLaunchVerify(wxCommandEvent&)
{
    LaunchModule(ID_MODULE_VERIFY, wxString::Format("VLT %d", GetModuleLanguageId()));
}

void Veltro3MainAppStandardView::OnLaunchInspect(wxCommandEvent&)
{
    LaunchModule(ID_MODULE_INSPECT, wxString());
}

void Veltro3MainAppStandardView::OnLaunchEdit(wxCommandEvent&)
{
    LaunchModule(ID_MODULE_EDIT, wxString());
}
