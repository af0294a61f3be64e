// Text rendered once into bitmaps of one colour whose alpha carries the glyph
// coverage, alpha compositing of such bitmaps over pictures, and the
// launcher's font and its text colour on pictures.
#pragma once

#include <wx/arrstr.h>
#include <wx/bitmap.h>
#include <wx/colour.h>
#include <wx/font.h>
#include <wx/gdicmn.h>
#include <wx/string.h>

// Lines of text in `colour`, alpha from coverage. A size component of -1 fits
// that dimension to the text; a position component of -1 takes the anchor
// from `alignment`. With a width given, the font shrinks (down to 7 points)
// until the widest line fits the room right of the anchor. Invalid when the
// size comes out empty.
wxBitmap DrawTextLinesToBitmap(const wxSize& size, const wxPoint& position, const wxFont& font,
                               const wxArrayString& lines, const wxColour& colour, int alignment,
                               int lineSpacing);

// The same for one text whose lines are separated by line feeds; a trailing
// line feed adds no empty line.
wxBitmap DrawTextToBitmap(const wxSize& size, const wxPoint& position, const wxFont& font,
                          const wxString& text, const wxColour& colour, int alignment,
                          int lineSpacing);

// A copy of `base` with `overlay` laid over it at `position` (wxDefaultPosition
// is the top-left corner), "over" operator on unpremultiplied colour. Invalid
// when either input is invalid.
wxBitmap CompositeBitmap(const wxBitmap& base, const wxBitmap& overlay,
                         const wxPoint& position = wxDefaultPosition);

// Tahoma of the given size and weight (wxNORMAL, wxBOLD or a wxFontWeight);
// -1 for either gives 12-point regular.
wxFont GetUIFont(int pointSize, int weight);

// The text colour on the launcher's light pictures: the given colour, unless
// a dark desktop theme made it light.
wxColour DarkOnPicture(const wxColour& colour);
