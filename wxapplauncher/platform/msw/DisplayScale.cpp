#include "platform/DisplayScale.h"

#include <wx/window.h>

double PictureScale(const wxWindow& window)
{
    // A per-monitor aware program sees its monitor's resolution here; the content
    // scale factor stays 1 on Windows.
    return window.GetDPIScaleFactor();
}

double DrawingUnitsPerDip(double scale)
{
    return scale;
}
