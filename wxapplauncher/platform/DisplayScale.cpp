#include "platform/DisplayScale.h"

wxBitmap ScaledBitmap(const wxImage& image, double scale)
{
    wxBitmap bitmap(image, wxBITMAP_SCREEN_DEPTH, scale);
    if (bitmap.IsOk())
        bitmap.SetScaleFactor(scale);
    return bitmap;
}
