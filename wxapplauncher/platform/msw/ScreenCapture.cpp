#include "platform/ScreenCapture.h"

#include <wx/bitmap.h>
#include <wx/dcmemory.h>
#include <wx/dcscreen.h>

// The toolkit counts physical pixels on Windows, so the logical area is the
// screen's own; a blit from the screen reads what it shows.
wxImage CaptureScreen(const wxRect& logical)
{
    if (logical.IsEmpty())
        return wxImage();
    wxBitmap shot(logical.GetSize(), 24);
    if (!shot.IsOk())
        return wxImage();
    {
        wxScreenDC screen;
        wxMemoryDC memory(shot);
        if (!memory.Blit(0, 0, logical.width, logical.height, &screen, logical.x, logical.y))
            return wxImage();
    }
    return shot.ConvertToImage();
}
