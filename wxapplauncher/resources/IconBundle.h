// Window icons from the executable's icon group resource.
#pragma once

#include <wx/iconbndl.h>
#include <wx/string.h>

class ResourceImage;

// Icons of the named group; a depth of 0 or less takes every image. Images that are
// missing or cannot be decoded are skipped.
wxIconBundle LoadIconBundle(const wxString& name, int depth);
wxIconBundle LoadIconBundle(const ResourceImage& image, const wxString& name, int depth);
