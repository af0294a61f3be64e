#include "app/Veltro3App.h"

#include <wx/display.h>
#include <wx/msgdlg.h>
#include <wx/settings.h>

namespace {

// What the launcher's windows take on the screen, in logical pixels: the frame (its
// 564 x 344 view under the menu bar), the start-up splash and the About box.
const wxSize kWindowSizes[] = {{564, 369}, {445, 425}, {443, 454}};

wxSize RequiredScreenSize()
{
    wxSize required;
    for (const wxSize& size : kWindowSizes)
        required.IncTo(size);
    return required;
}

} // namespace

bool Veltro3App::CheckScreenResolution()
{
    // Logical pixels: on a desktop scaled to 200% a 2560 x 1440 screen offers 1280 x 720.
    const wxSize required = RequiredScreenSize();
    const int screenWidth = wxSystemSettingsNative::GetMetric(wxSYS_SCREEN_X, nullptr);
    const int screenHeight = wxSystemSettingsNative::GetMetric(wxSYS_SCREEN_Y, nullptr);
    if (screenWidth >= required.x && screenHeight >= required.y)
        return true;

    // The user sets the monitor in its own pixels, which the desktop's scale multiplies.
    const double scale = wxDisplay().GetScaleFactor();
    wxMessageBox(
        wxString::Format(
            _("Please set your monitor to a supported resolution.\nMinimum required: %d x %d"),
            wxRound(required.x * scale), wxRound(required.y * scale)),
        wxString(), wxOK | wxCENTRE);
    return false;
}
