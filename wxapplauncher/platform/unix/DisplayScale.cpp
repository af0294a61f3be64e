#include "platform/DisplayScale.h"

#include <wx/window.h>

double PictureScale(const wxWindow& window)
{
    return window.GetContentScaleFactor();
}

double DrawingUnitsPerDip(double)
{
    return 1.0;
}
