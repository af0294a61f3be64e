#include "about/PictureWindow.h"

#include <wx/display.h>
#include <wx/region.h>

void CentreOnPrimaryDisplay(wxTopLevelWindow* window, const wxSize& size)
{
    const wxRect screen = wxDisplay().GetGeometry();
    window->Move(screen.x + (screen.width - size.x) / 2, screen.y + (screen.height - size.y) / 2);
}

void ShapeToPicture(wxTopLevelWindow* window, const wxBitmap& picture)
{
    if (!picture.IsOk())
        return;
    wxRegion shape;
    // A region from a bitmap counts physical pixels; a window is shaped in logical ones.
    if (picture.GetMask())
        shape.Union(picture);
    else
        shape.Union(wxRect(picture.GetLogicalSize()));
    window->SetShape(shape);
}
