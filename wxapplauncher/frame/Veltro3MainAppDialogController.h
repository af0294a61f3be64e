// The launcher window's client panel: its fixed best size and the hook for the
// module buttons' state.
#pragma once

#include <wx/panel.h>

class Veltro3MainAppDialogController : public wxPanel
{
public:
    Veltro3MainAppDialogController(wxWindow* parent, wxWindowID id, const wxPoint& pos,
                                   const wxSize& size, long style, const wxString& name);
    ~Veltro3MainAppDialogController() override;

    virtual void UpdateModuleButtons();

protected:
    wxSize DoGetBestSize() const override;

private:
    wxDECLARE_EVENT_TABLE();
};
