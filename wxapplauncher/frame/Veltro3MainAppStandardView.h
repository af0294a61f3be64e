// The launcher view: routes the module buttons to module launching, and the
// one launch operation that every entry point ends in.
#pragma once

#include "frame/Veltro3MainAppDialogController.h"

#include <wx/string.h>

class Veltro3MainAppStandardView : public Veltro3MainAppDialogController
{
public:
    Veltro3MainAppStandardView(wxWindow* parent, wxWindowID id, const wxPoint& pos,
                               const wxSize& size, long style, const wxString& name);
    ~Veltro3MainAppStandardView() override;

    // Starts a module (1001-1006) with an optional argument; every failure is silent.
    void LaunchModule(int moduleId, wxString argument);

    void OnLaunchPrinter(wxCommandEvent& event);
    void OnLaunchMonitor(wxCommandEvent& event);
    void OnLaunchDeviceLink(wxCommandEvent& event);
    void OnLaunchVerify(wxCommandEvent& event);
    void OnLaunchInspect(wxCommandEvent& event);
    void OnLaunchEdit(wxCommandEvent& event);

private:
    wxDECLARE_EVENT_TABLE();
};

// The Windows language number that the Verify module expects for the user's
// language as start-up decided it.
int GetModuleLanguageId();
