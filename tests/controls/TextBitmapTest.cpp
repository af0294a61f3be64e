// Text drawn into alpha bitmaps, and alpha compositing, checked pixel by pixel.
#include "controls/TextBitmap.h"

#include <gtest/gtest.h>
#include <wx/image.h>

#include <functional>

namespace {

wxImage Pixels(const wxBitmap& bitmap)
{
    wxImage image = bitmap.ConvertToImage();
    if (!image.HasAlpha())
        image.InitAlpha();
    return image;
}

int LineHeight(int points)
{
    return DrawTextToBitmap(wxSize(-1, -1), wxDefaultPosition, GetUIFont(points, wxNORMAL), "a",
                            *wxBLACK, 0, 0)
        .GetHeight();
}

// The right-most column that has any coverage, -1 for none.
int LastInkColumn(const wxImage& image)
{
    for (int x = image.GetWidth() - 1; x >= 0; --x)
        for (int y = 0; y < image.GetHeight(); ++y)
            if (image.GetAlpha(x, y) > 0)
                return x;
    return -1;
}

wxBitmap Filled(int w, int h, const wxColour& colour, unsigned char alpha)
{
    wxImage image(w, h);
    image.SetRGB(wxRect(0, 0, w, h), colour.Red(), colour.Green(), colour.Blue());
    image.InitAlpha();
    memset(image.GetAlpha(), alpha, static_cast<size_t>(w) * h);
    return wxBitmap(image);
}

TEST(TextBitmapTest, DrawsText)
{
    const wxFont font = GetUIFont(12, wxNORMAL);
    const wxString text = "Hg Profile";
    const wxImage white =
        Pixels(DrawTextToBitmap(wxSize(-1, -1), wxDefaultPosition, font, text, *wxWHITE, 0, 0));
    const wxImage black =
        Pixels(DrawTextToBitmap(wxSize(-1, -1), wxDefaultPosition, font, text, *wxBLACK, 0, 0));
    const int width10 = DrawTextToBitmap(wxSize(-1, -1), wxDefaultPosition, GetUIFont(10, wxNORMAL),
                                         text, *wxBLACK, 0, 0)
                            .GetWidth();
    const int h = LineHeight(12);
    struct Case
    {
        const char* name;
        std::function<bool()> holds;
    };
    const Case cases[] = {
        {"white text: white everywhere, opaque cores, clear around",
         [&] {
             int lo = 255, hi = 0;
             for (int i = 0; i < white.GetWidth() * white.GetHeight(); ++i) {
                 lo = std::min<int>(lo, white.GetAlpha()[i]);
                 hi = std::max<int>(hi, white.GetAlpha()[i]);
                 if (white.GetData()[3 * i] != 255 || white.GetData()[3 * i + 2] != 255)
                     return false;
             }
             return lo == 0 && hi == 255;
         }},
        {"black text: black, same alpha shape as white",
         [&] {
             if (black.GetSize() != white.GetSize() || black.GetRed(3, 3) != 0)
                 return false;
             for (int i = 0; i < white.GetWidth() * white.GetHeight(); ++i)
                 if (std::abs(black.GetAlpha()[i] - white.GetAlpha()[i]) > 48)
                     return false;
             return true;
         }},
        {"empty text with a size: fully transparent canvas in the colour",
         [&] {
             const wxImage canvas = Pixels(DrawTextToBitmap(wxSize(152, 58), wxDefaultPosition,
                                                            font, "", wxColour(10, 20, 30), 0, 0));
             return canvas.GetSize() == wxSize(152, 58) && LastInkColumn(canvas) == -1 &&
                    canvas.GetGreen(151, 57) == 20;
         }},
        {"empty text, no size: invalid",
         [&] {
             return !DrawTextToBitmap(wxSize(-1, -1), wxDefaultPosition, font, "", *wxBLACK, 0, 0)
                         .IsOk();
         }},
        {"too narrow: one point at a time down to the size that fits",
         [&] {
             return DrawTextToBitmap(wxSize(width10 + 2, -1), wxDefaultPosition, font, text,
                                     *wxBLACK, 0, 0)
                        .GetHeight() == LineHeight(10);
         }},
        {"far too narrow: stops at 7 points",
         [&] {
             return DrawTextToBitmap(wxSize(5, -1), wxDefaultPosition, font, text, *wxBLACK, 0, 0)
                        .GetHeight() == LineHeight(7);
         }},
        {"a long label right of an icon shrinks instead of being cut",
         [&] {
             const wxImage label = Pixels(DrawTextToBitmap(wxSize(152, 58), wxPoint(70, 29), font,
                                                           wxString::FromUTF8("Verknüpfung"),
                                                           *wxBLACK, wxALIGN_CENTER_VERTICAL, 0));
             const int last = LastInkColumn(label);
             return last > 70 && last < 151;
         }},
        {"a, LF, LF, b: three lines; a, LF: one; spacing -1 overlaps a row",
         [&] {
             auto height = [&](const wxString& s, int spacing) {
                 return DrawTextToBitmap(wxSize(-1, -1), wxDefaultPosition, font, s, *wxBLACK, 0,
                                         spacing)
                     .GetHeight();
             };
             return height("a\n\nb", 0) == 3 * h && height("a\n", 0) == h &&
                    height("a\nb", -1) == 2 * h - 2;
         }},
        {"bottom alignment puts the text at the bottom edge",
         [&] {
             const wxImage bottom = Pixels(DrawTextToBitmap(
                 wxSize(100, 3 * h), wxDefaultPosition, font, "H", *wxBLACK, wxALIGN_BOTTOM, 0));
             for (int y = 0; y < 2 * h; ++y)
                 for (int x = 0; x < 100; ++x)
                     if (bottom.GetAlpha(x, y) != 0)
                         return false;
             return LastInkColumn(bottom) >= 0;
         }},
        {"GetUIFont: 8 bold Tahoma; -1 gives 12 regular",
         [&] {
             const wxFont bold = GetUIFont(8, wxBOLD);
             const wxFont fallback = GetUIFont(-1, wxBOLD);
             return bold.GetPointSize() == 8 && bold.GetWeight() == wxFONTWEIGHT_BOLD &&
                    bold.GetFaceName() == "Tahoma" && fallback.GetPointSize() == 12 &&
                    fallback.GetWeight() == wxFONTWEIGHT_NORMAL;
         }},
    };
    for (const Case& c : cases)
        EXPECT_TRUE(c.holds()) << c.name;
}

TEST(TextBitmapTest, Composites)
{
    wxImage baseImage = Pixels(Filled(8, 8, wxColour(0, 0, 255), 255));
    baseImage.SetRGB(0, 0, 40, 50, 60);
    baseImage.SetAlpha(0, 0, 0);
    const wxBitmap base(baseImage);
    const wxImage red = Pixels(Filled(4, 4, wxColour(255, 0, 0), 255));
    wxImage masked(4, 4);
    masked.SetRGB(wxRect(0, 0, 4, 4), 255, 0, 255);
    masked.SetRGB(1, 1, 0, 255, 0);
    masked.SetMaskColour(255, 0, 255);

    struct Case
    {
        const char* name;
        wxBitmap overlay;
        wxPoint at;
        wxPoint probe;
        wxColour expected; // alpha in the colour's alpha
    };
    const Case cases[] = {
        {"opaque overlay: its pixels", wxBitmap(red), wxPoint(2, 2), wxPoint(5, 5),
         wxColour(255, 0, 0, 255)},
        {"opaque overlay: base outside it", wxBitmap(red), wxPoint(2, 2), wxPoint(6, 6),
         wxColour(0, 0, 255, 255)},
        {"negative position reads the overlay from inside", wxBitmap(red), wxPoint(-2, -2),
         wxPoint(1, 1), wxColour(255, 0, 0, 255)},
        {"transparent overlay keeps the base", Filled(8, 8, *wxRED, 0), wxDefaultPosition,
         wxPoint(3, 3), wxColour(0, 0, 255, 255)},
        {"transparent over transparent: black, alpha 0", Filled(8, 8, *wxRED, 0), wxDefaultPosition,
         wxPoint(0, 0), wxColour(0, 0, 0, 0)},
        {"half overlay over opaque base mixes", Filled(8, 8, *wxRED, 128), wxDefaultPosition,
         wxPoint(4, 4), wxColour(128, 0, 127, 255)},
        {"half overlay over clear base keeps its colour", Filled(8, 8, *wxRED, 128),
         wxDefaultPosition, wxPoint(0, 0), wxColour(255, 0, 0, 128)},
        {"masked overlay: mask is clear", wxBitmap(masked), wxPoint(4, 4), wxPoint(4, 4),
         wxColour(0, 0, 255, 255)},
        {"masked overlay: the rest is opaque", wxBitmap(masked), wxPoint(4, 4), wxPoint(5, 5),
         wxColour(0, 255, 0, 255)},
        {"wholly outside: a copy of the base", wxBitmap(red), wxPoint(8, 0), wxPoint(0, 0),
         wxColour(40, 50, 60, 0)},
    };
    for (const Case& c : cases) {
        const wxImage out = Pixels(CompositeBitmap(base, c.overlay, c.at));
        const int x = c.probe.x, y = c.probe.y;
        EXPECT_EQ(
            wxColour(out.GetRed(x, y), out.GetGreen(x, y), out.GetBlue(x, y), out.GetAlpha(x, y)),
            c.expected)
            << c.name;
    }
    EXPECT_FALSE(CompositeBitmap(wxBitmap(), base).IsOk());
    EXPECT_FALSE(CompositeBitmap(base, wxBitmap()).IsOk());
    EXPECT_EQ(Pixels(base).GetAlpha(0, 0), 0) << "the base is left alone";
}

} // namespace
