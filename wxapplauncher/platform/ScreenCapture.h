// Reading what the screen shows. Only an X11 desktop lets a program do that; elsewhere
// (Wayland) and on failure the result is an invalid image.
#pragma once

#include <wx/gdicmn.h>
#include <wx/image.h>

// The area is in logical pixels; the image has the screen's physical pixels of it, twice
// as many each way on a desktop scaled to 200%.
wxImage CaptureScreen(const wxRect& logical);
