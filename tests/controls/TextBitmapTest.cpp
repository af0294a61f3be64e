// Text drawn into alpha bitmaps, and alpha compositing, checked pixel by pixel.
#include "controls/TextBitmap.h"

#include <gtest/gtest.h>
#include <wx/image.h>

#include <algorithm>
#include <tuple>

namespace {

wxImage Draw(const wxString& text, int points = 12, wxSize size = wxSize(-1, -1),
             const wxColour& colour = *wxBLACK, wxPoint at = wxDefaultPosition, int spacing = 0)
{
    return DrawTextToBitmap(size, at, GetUIFont(points, wxNORMAL), text, colour,
                            wxALIGN_CENTER_VERTICAL * (at.y != -1), spacing)
        .ConvertToImage();
}

// The right-most column with any coverage, -1 for none.
int LastInkColumn(const wxImage& image)
{
    for (int x = image.GetWidth() - 1; x >= 0; --x)
        for (int y = 0; y < image.GetHeight(); ++y)
            if (image.GetAlpha(x, y) > 0)
                return x;
    return -1;
}

wxBitmap Filled(const wxColour& colour, unsigned char alpha, int side = 8)
{
    wxImage image(side, side);
    image.SetRGB(wxRect(0, 0, side, side), colour.Red(), colour.Green(), colour.Blue());
    image.InitAlpha();
    memset(image.GetAlpha(), alpha, side * side);
    return wxBitmap(image);
}

TEST(TextBitmapTest, DrawsText)
{
    // Coverage goes to alpha, the same for light and dark text; the colour is flat.
    const wxString text = "Hg Profile";
    const wxImage white = Draw(text, 12, wxSize(-1, -1), *wxWHITE), black = Draw(text);
    ASSERT_EQ(black.GetSize(), white.GetSize());
    const long n = long(white.GetWidth()) * white.GetHeight();
    const unsigned char* alpha = white.GetAlpha();
    EXPECT_EQ(*std::min_element(alpha, alpha + n), 0) << "clear around the glyphs";
    EXPECT_EQ(*std::max_element(alpha, alpha + n), 255) << "opaque glyph cores";
    EXPECT_TRUE(
        std::all_of(white.GetData(), white.GetData() + 3 * n, [](int c) { return c == 255; }));
    int worst = 0;
    for (long i = 0; i < n; ++i)
        worst = std::max(worst, std::abs(black.GetAlpha()[i] - alpha[i]));
    EXPECT_LE(worst, 48) << "black text has the alpha shape of white text";

    const wxImage canvas = Draw("", 12, wxSize(152, 58), wxColour(10, 20, 30));
    EXPECT_EQ(canvas.GetSize(), wxSize(152, 58));
    EXPECT_EQ(LastInkColumn(canvas), -1) << "an empty text gives a transparent canvas";
    EXPECT_EQ(canvas.GetGreen(151, 57), 20);

    const int h = Draw("a").GetHeight();
    const std::tuple<const char*, int, int> heights[] = {
        {"a, LF, LF, b: three lines", Draw("a\n\nb").GetHeight(), 3 * h},
        {"a, LF: one line", Draw("a\n").GetHeight(), h},
        {"spacing -1 overlaps a row",
         Draw("a\nb", 12, wxSize(-1, -1), *wxBLACK, wxDefaultPosition, -1).GetHeight(), 2 * h - 2},
        {"too narrow: shrinks one point at a time until it fits",
         Draw(text, 12, wxSize(Draw(text, 10).GetWidth() + 2, -1)).GetHeight(),
         Draw("a", 10).GetHeight()},
        {"far too narrow: stops at 7 points", Draw(text, 12, wxSize(5, -1)).GetHeight(),
         Draw("a", 7).GetHeight()},
    };
    for (const auto& [name, height, expected] : heights)
        EXPECT_EQ(height, expected) << name;

    // A label right of an icon shrinks to the room it has instead of being cut.
    const wxImage label =
        Draw(wxString::FromUTF8("Verknüpfung"), 12, wxSize(152, 58), *wxBLACK, wxPoint(70, 29));
    EXPECT_GT(LastInkColumn(label), 70);
    EXPECT_LT(LastInkColumn(label), 151);

    EXPECT_EQ(GetUIFont(8, wxBOLD).GetWeight(), wxFONTWEIGHT_BOLD);
}

TEST(TextBitmapTest, Composites)
{
    wxImage baseImage = Filled(wxColour(0, 0, 255), 255).ConvertToImage();
    baseImage.SetRGB(0, 0, 40, 50, 60);
    baseImage.SetAlpha(0, 0, 0);
    const wxBitmap base(baseImage);
    const wxBitmap red = Filled(*wxRED, 255, 4);
    wxImage masked(4, 4);
    masked.SetRGB(wxRect(0, 0, 4, 4), 255, 0, 255);
    masked.SetRGB(1, 1, 0, 255, 0);
    masked.SetMaskColour(255, 0, 255);

    const struct
    {
        const char* name;
        wxBitmap overlay;
        wxPoint at, probe;
        wxColour expected; // with alpha
    } cases[] = {
        {"opaque overlay: its pixels", red, {2, 2}, {5, 5}, {255, 0, 0, 255}},
        {"opaque overlay: base outside it", red, {2, 2}, {6, 6}, {0, 0, 255, 255}},
        {"negative position", red, {-2, -2}, {1, 1}, {255, 0, 0, 255}},
        {"transparent overlay keeps the base", Filled(*wxRED, 0), {0, 0}, {3, 3}, {0, 0, 255, 255}},
        {"transparent over transparent: black", Filled(*wxRED, 0), {0, 0}, {0, 0}, {0, 0, 0, 0}},
        {"half over opaque mixes", Filled(*wxRED, 128), {0, 0}, {4, 4}, {128, 0, 127, 255}},
        {"half over clear keeps its colour", Filled(*wxRED, 128), {0, 0}, {0, 0}, {255, 0, 0, 128}},
        {"mask is clear", wxBitmap(masked), {4, 4}, {4, 4}, {0, 0, 255, 255}},
        {"rest of a masked overlay", wxBitmap(masked), {4, 4}, {5, 5}, {0, 255, 0, 255}},
        {"wholly outside: a copy of the base", red, {8, 0}, {0, 0}, {40, 50, 60, 0}},
    };
    for (const auto& c : cases) {
        wxImage out = CompositeBitmap(base, c.overlay, c.at).ConvertToImage();
        const int x = c.probe.x, y = c.probe.y;
        EXPECT_EQ(wxColour(out.GetRed(x, y), out.GetGreen(x, y), out.GetBlue(x, y),
                           out.HasAlpha() ? out.GetAlpha(x, y) : 255),
                  c.expected)
            << c.name;
    }
    EXPECT_FALSE(CompositeBitmap(wxBitmap(), base).IsOk());
    EXPECT_FALSE(CompositeBitmap(base, wxBitmap()).IsOk());
    EXPECT_EQ(base.ConvertToImage().GetAlpha(0, 0), 0) << "the base is left alone";
}

} // namespace
