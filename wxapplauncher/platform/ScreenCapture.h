// Reading what the screen shows. Only an X11 desktop lets a program do that; elsewhere
// (Wayland) and on failure the result is an invalid image.
#pragma once

#include <wx/gdicmn.h>
#include <wx/image.h>

wxImage CaptureScreen(const wxRect& area);
