// The three embedded image sets, registered once per process into the memory file system,
// and their pictures fetched by resource name for the display's scale.
#pragma once

#include <wx/bitmap.h>
#include <wx/bmpbndl.h>

struct EmbeddedImageSet;

void RegisterLauncherImages();
void RegisterHelpImages();
void RegisterCommonImages();

// Guarded forms: add the image handlers and register the set on first use only.
void EnsureLauncherImages();
void EnsureHelpImages();
void EnsureCommonImages();

// Adds a set's files under "XRC_resource/<stem>$<file>" and loads its XRC document.
void RegisterImageSet(const EmbeddedImageSet& set);

// A registered picture by its resource name as a bundle of the picture and, for a scale
// above 1, its 2x rendering: for "<stem>$<name>.png" the set's "<name>@2x.png".
wxBitmapBundle LoadPictureBundle(const wxString& name, double scale);

// The picture to draw at `scale`: above 1, of the physical size with its scale factor set,
// so that it keeps the picture's logical size.
wxBitmap LoadPicture(const wxString& name, double scale);
