// How the launcher's pictures and text meet a scaled display. GTK counts window
// coordinates in device-independent pixels and scales drawing itself; Windows counts
// physical pixels and leaves the scaling to the program.
#pragma once

#include <wx/bitmap.h>
#include <wx/image.h>

class wxWindow;

// The scale at which pictures and text are rendered for `window`: 2 on a 200%
// display, so that its physical pixels show the pictures' own.
double PictureScale(const wxWindow& window);

// How many drawing units of a memory DC on a bitmap of `scale` make one
// device-independent pixel: 1 where the toolkit scales drawing itself.
double DrawingUnitsPerDip(double scale);

// A bitmap of the image's pixels with the scale factor `scale`. The toolkit's own
// constructor drops the scale on Windows.
wxBitmap ScaledBitmap(const wxImage& image, double scale);
