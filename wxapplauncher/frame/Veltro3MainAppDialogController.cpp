#include "frame/Veltro3MainAppDialogController.h"

namespace {
// The launcher picture is laid out for exactly this client size.
const wxSize kViewSize(564, 344);
} // namespace

wxBEGIN_EVENT_TABLE(Veltro3MainAppDialogController, wxPanel) wxEND_EVENT_TABLE()

    Veltro3MainAppDialogController::Veltro3MainAppDialogController(wxWindow* parent, wxWindowID id,
                                                                   const wxPoint& pos,
                                                                   const wxSize& size, long style,
                                                                   const wxString& name)
    : wxPanel(parent, id, pos, size, style, name)
{
    SetInitialSize(size);
}

Veltro3MainAppDialogController::~Veltro3MainAppDialogController() = default;

void Veltro3MainAppDialogController::UpdateModuleButtons() {}

wxSize Veltro3MainAppDialogController::DoGetBestSize() const
{
    return kViewSize;
}
