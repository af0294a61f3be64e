// Reading what the screen shows. Where the desktop does not let a program do that
// (Wayland) and on failure the result is an invalid image.
#pragma once

#include <wx/gdicmn.h>
#include <wx/image.h>

// The area is in logical pixels; the image has the screen's physical pixels of it, twice
// as many each way on a desktop scaled to 200%.
wxImage CaptureScreen(const wxRect& logical);
