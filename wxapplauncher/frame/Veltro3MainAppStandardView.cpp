#include "frame/Veltro3MainAppStandardView.h"

#include "frame/Ids.h"

wxBEGIN_EVENT_TABLE(Veltro3MainAppStandardView, Veltro3MainAppDialogController)
    EVT_BUTTON(ID_BUTTON_MONITOR, Veltro3MainAppStandardView::OnLaunchMonitor)
        EVT_BUTTON(ID_BUTTON_PRINTER, Veltro3MainAppStandardView::OnLaunchPrinter)
            EVT_BUTTON(ID_BUTTON_DEVICELINK, Veltro3MainAppStandardView::OnLaunchDeviceLink)
                EVT_BUTTON(ID_BUTTON_EDIT, Veltro3MainAppStandardView::OnLaunchEdit)
                    EVT_BUTTON(ID_BUTTON_INSPECT, Veltro3MainAppStandardView::OnLaunchInspect)
                        EVT_BUTTON(ID_BUTTON_VERIFY, Veltro3MainAppStandardView::OnLaunchVerify)
                            wxEND_EVENT_TABLE()

                                Veltro3MainAppStandardView::Veltro3MainAppStandardView(
                                    wxWindow* parent, wxWindowID id, const wxPoint& pos,
                                    const wxSize& size, long style, const wxString& name)
    : Veltro3MainAppDialogController(parent, id, pos, size, style, name)
{
    UpdateModuleButtons();
}

Veltro3MainAppStandardView::~Veltro3MainAppStandardView() = default;

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
