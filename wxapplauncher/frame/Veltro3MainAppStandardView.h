// The launcher view: the six module buttons and the Help button over the
// launcher picture, the Inspect button's drop target, the routing of the
// module buttons to module launching, and the one launch operation that every
// entry point ends in.
#pragma once

#include "frame/Veltro3MainAppDialogController.h"

#include <wx/font.h>
#include <wx/string.h>

class ZelStaticBitmap;

class Veltro3MainAppStandardView : public Veltro3MainAppDialogController
{
public:
    Veltro3MainAppStandardView(wxWindow* parent, wxWindowID id, const wxPoint& pos,
                               const wxSize& size, long style, const wxString& name);
    ~Veltro3MainAppStandardView() override;

    void OnSysColourChanged(wxSysColourChangedEvent& event) override;
    // Hands the buttons their images, colours and cursors and enables the File
    // menu's module commands; running it again changes nothing visible.
    void UpdateModuleButtons() override;

    // A button image: the icon at (6, 2) and the label right of it, vertically
    // centred, both over `canvas`; `offset` moves only the label.
    wxBitmap ComposeButtonImage(const wxBitmap& canvas, const wxBitmap& icon, const wxString& label,
                                const wxPoint& offset);

    // Starts a module (1001-1006) with an optional argument; every failure is silent.
    void LaunchModule(int moduleId, wxString argument);

    void OnLaunchPrinter(wxCommandEvent& event);
    void OnLaunchMonitor(wxCommandEvent& event);
    void OnLaunchDeviceLink(wxCommandEvent& event);
    void OnLaunchVerify(wxCommandEvent& event);
    void OnLaunchInspect(wxCommandEvent& event);
    void OnLaunchEdit(wxCommandEvent& event);

private:
    // Per button, in the order Monitor, Printer, Device Link, Verify, Inspect, Edit.
    enum
    {
        MONITOR,
        PRINTER,
        DEVICELINK,
        VERIFY,
        INSPECT,
        EDIT,
        MODULE_COUNT
    };
    struct ButtonImages
    {
        wxBitmap normal, hover, pressed;
    };

    ButtonImages m_images[MODULE_COUNT];
    ZelStaticBitmap* m_buttons[MODULE_COUNT] = {};
    ZelStaticBitmap* m_helpButton = nullptr;
    wxFont m_labelFont; // the labels' font, fitted to the buttons

    wxDECLARE_EVENT_TABLE();
};

// The Windows language number that the Verify module expects for the user's
// language as start-up decided it.
int GetModuleLanguageId();
