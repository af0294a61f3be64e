// Window icons from the executable's icon group resource.
#pragma once

#include <wx/iconbndl.h>
#include <wx/image.h>
#include <wx/string.h>

class ResourceImage;

// Icons of the named group; a depth of 0 or less takes every image. Images that are
// missing or cannot be decoded are skipped.
wxIconBundle LoadIconBundle(const wxString& name, int depth);
wxIconBundle LoadIconBundle(const ResourceImage& image, const wxString& name, int depth);

// One icon image resource decoded to an image with alpha; invalid when it cannot be.
wxImage DecodeIconResourceImage(const unsigned char* data, std::size_t size);
