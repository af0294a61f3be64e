#include "app/Veltro3App.h"

#include "platform/DisplaySession.h"
#include "platform/MessageBox.h"

#include <wx/display.h>
#include <wx/settings.h>

#include <algorithm>

namespace {

struct Resolution
{
    int width;
    int height;
};

const Resolution kResolutionPresets[] = {
    {800, 600},  {1024, 768},  {1152, 864}, {1280, 768},
    {1280, 960}, {1280, 1024}, {1280, 600}, {1280, 720},
};

// What the launcher's windows take on the screen, in logical pixels: the frame (its
// 564 x 344 view under the menu bar), the start-up splash and the About box.
const wxSize kWindowSizes[] = {{564, 369}, {445, 425}, {443, 454}};

} // namespace

void Veltro3App::GetMinimumResolution(int preset, int& width, int& height)
{
    if (preset < 0 || preset >= int(WXSIZEOF(kResolutionPresets)))
        preset = 0;
    width = kResolutionPresets[preset].width;
    height = kResolutionPresets[preset].height;
}

bool Veltro3App::CheckScreenResolution(int preset)
{
    int width = 0, height = 0;
    GetMinimumResolution(preset, width, height);
    // The preset counts the monitor's own pixels. A desktop scaled to 200% shows a
    // 2560 x 1440 monitor as 1280 x 720, and there the windows, scaled alike, need
    // more than the preset.
    const double scale = wxDisplay().GetScaleFactor();
    for (const wxSize& size : kWindowSizes) {
        width = std::max(width, wxRound(size.x * scale));
        height = std::max(height, wxRound(size.y * scale));
    }
    const int screenWidth = wxRound(wxSystemSettingsNative::GetMetric(wxSYS_SCREEN_X) * scale);
    const int screenHeight = wxRound(wxSystemSettingsNative::GetMetric(wxSYS_SCREEN_Y) * scale);
    if (screenWidth >= width && screenHeight >= height)
        return true;

    if (HasInputSeat())
        ShowMessageBox(
            wxString::Format(
                _("Please set your monitor to a supported resolution.\nMinimum required: %d x %d"),
                width, height),
            wxString(), wxOK | wxCENTRE);
    return false;
}
