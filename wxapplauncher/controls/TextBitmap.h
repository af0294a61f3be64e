// Text rendered once into bitmaps of one colour whose alpha carries the glyph
// coverage, alpha compositing of such bitmaps over pictures, and the
// launcher's font and its text colour on pictures.
#pragma once

#include <wx/arrstr.h>
#include <wx/bitmap.h>
#include <wx/colour.h>
#include <wx/font.h>
#include <wx/gdicmn.h>
#include <wx/image.h>
#include <wx/string.h>

// Lines of text in `colour`, alpha from coverage. A size component of -1 fits
// that dimension to the text; a position component of -1 takes the anchor
// from `alignment`. With a width given, the font shrinks (down to 7 points)
// until the widest line fits the room right of the anchor. Invalid when the
// size comes out empty. Sizes and positions are device-independent pixels; the
// bitmap has `scale` times as many physical ones, with that scale factor.
wxBitmap DrawTextLinesToBitmap(const wxSize& size, const wxPoint& position, const wxFont& font,
                               const wxArrayString& lines, const wxColour& colour, int alignment,
                               int lineSpacing, double scale = 1.0);

// The same as an image of the physical pixels, for callers that blend it themselves.
wxImage DrawTextLinesToImage(const wxSize& size, const wxPoint& position, const wxFont& font,
                             const wxArrayString& lines, const wxColour& colour, int alignment,
                             int lineSpacing, double scale = 1.0);

// The same for one text whose lines are separated by line feeds; a trailing
// line feed adds no empty line.
wxBitmap DrawTextToBitmap(const wxSize& size, const wxPoint& position, const wxFont& font,
                          const wxString& text, const wxColour& colour, int alignment,
                          int lineSpacing, double scale = 1.0);

// The font at the largest size, from its own down to 7 points, at which every
// line is at most `room` - 2 device-independent pixels wide, for text rendered at
// `scale`.
wxFont FitFontToWidth(const wxFont& font, const wxArrayString& lines, int room, double scale = 1.0);

// A copy of `base` with `overlay` laid over it at `position` (wxDefaultPosition
// is the top-left corner), "over" operator on unpremultiplied colour. Invalid
// when either input is invalid. The position is in the base's device-independent pixels;
// an overlay of another scale factor is resampled to the base's.
wxBitmap CompositeBitmap(const wxBitmap& base, const wxBitmap& overlay,
                         const wxPoint& position = wxDefaultPosition);

// Tahoma of the given size and weight (wxNORMAL, wxBOLD or a wxFontWeight);
// -1 for either gives 12-point regular.
wxFont GetUIFont(int pointSize, int weight);

// The text colour on the launcher's light pictures: the given colour, unless
// a dark desktop theme made it light.
wxColour DarkOnPicture(const wxColour& colour);
