// What the splash, About and module windows share: sizing, placing and shaping a
// borderless window to its picture.
#pragma once

#include <wx/bitmap.h>
#include <wx/toplevel.h>

// Centres a window of the given size on the primary display, whose origin need not be (0, 0).
void CentreOnPrimaryDisplay(wxTopLevelWindow* window, const wxSize& size);

// Shapes the window to the picture's mask, or to its whole rectangle when it has none.
// A missing picture leaves the window unshaped.
void ShapeToPicture(wxTopLevelWindow* window, const wxBitmap& picture);
