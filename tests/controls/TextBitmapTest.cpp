// Text drawn into alpha bitmaps, and alpha compositing, checked pixel by pixel.
#include "controls/TextBitmap.h"

#include <gtest/gtest.h>
#include <wx/image.h>

#include <algorithm>
#include <vector>

namespace {

wxImage Draw(const wxString& text, int points = 12, wxSize size = wxSize(-1, -1),
             const wxColour& colour = *wxBLACK, wxPoint at = wxDefaultPosition)
{
    return DrawTextToBitmap(size, at, GetUIFont(points, wxNORMAL), text, colour,
                            wxALIGN_CENTER_VERTICAL * (at.y != -1), 0)
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
    // Where a pixel is transparent its colour is lost on Windows, whose bitmaps carry
    // their colour multiplied by the alpha.
    for (long i = 0; i < n; ++i)
        if (alpha[i] > 0 && !std::all_of(white.GetData() + 3 * i, white.GetData() + 3 * i + 3,
                                         [](int c) { return c == 255; }))
            ADD_FAILURE() << "not flat at " << i;
    // The same shape: wherever white text covers more, black text covers at least about as
    // much. (GDI, Wine's at least, antialiases dark text on light with another gamma than
    // light text on dark: the coverage differs by up to half, its order does not.)
    std::vector<int> least(256, 255), most(256, 0);
    for (long i = 0; i < n; ++i) {
        least[alpha[i]] = std::min(least[alpha[i]], int(black.GetAlpha()[i]));
        most[alpha[i]] = std::max(most[alpha[i]], int(black.GetAlpha()[i]));
    }
    int disorder = 0;
    for (int v = 0; v < 256; ++v)
        for (int w = v + 1; w < 256; ++w)
            disorder += most[v] > least[w] + 48;
    EXPECT_EQ(disorder, 0) << "black text has the alpha shape of white text";

    EXPECT_EQ(Draw("a\n\nb").GetHeight(), 3 * Draw("a").GetHeight()) << "empty lines count";
    // Too narrow: one point smaller at a time until it fits, down to 7 points.
    EXPECT_EQ(Draw(text, 12, wxSize(Draw(text, 10).GetWidth() + 2, -1)).GetHeight(),
              Draw("a", 10).GetHeight());
    EXPECT_EQ(Draw(text, 12, wxSize(5, -1)).GetHeight(), Draw("a", 7).GetHeight());
    // A label right of an icon shrinks to the room it has instead of being cut.
    const wxImage label =
        Draw(wxString::FromUTF8("Verknüpfung"), 12, wxSize(152, 58), *wxBLACK, wxPoint(70, 29));
    EXPECT_GT(LastInkColumn(label), 70);
    EXPECT_LT(LastInkColumn(label), 151);
}

TEST(TextBitmapTest, Composites)
{
    wxImage baseImage = Filled(wxColour(0, 0, 255), 255).ConvertToImage();
    baseImage.SetRGB(0, 0, 40, 50, 60);
    baseImage.SetAlpha(0, 0, 0);
    const wxBitmap base(baseImage), red = Filled(*wxRED, 255, 4);

    const struct
    {
        wxBitmap overlay;
        wxPoint at, probe;
        wxColour expected; // with alpha
    } cases[] = {
        {red, {2, 2}, {5, 5}, {255, 0, 0, 255}},
        {red, {2, 2}, {6, 6}, {0, 0, 255, 255}},
        {red, {-2, -2}, {1, 1}, {255, 0, 0, 255}},
        {Filled(*wxRED, 0), {0, 0}, {0, 0}, {0, 0, 0, 0}},
        {Filled(*wxRED, 128), {0, 0}, {4, 4}, {128, 0, 127, 255}},
        {Filled(*wxRED, 128), {0, 0}, {0, 0}, {255, 0, 0, 128}},
        {red, {8, 0}, {0, 0}, {40, 50, 60, 0}},
    };
    for (const auto& c : cases) {
        wxImage out = CompositeBitmap(base, c.overlay, c.at).ConvertToImage();
        const int x = c.probe.x, y = c.probe.y;
        const int alpha = out.HasAlpha() ? out.GetAlpha(x, y) : 255;
        // A transparent pixel has no colour on Windows (premultiplied bitmaps).
        const wxColour shown =
            alpha ? wxColour(out.GetRed(x, y), out.GetGreen(x, y), out.GetBlue(x, y), alpha)
                  : wxColour(0, 0, 0, 0);
        EXPECT_EQ(shown, c.expected.Alpha() ? c.expected : wxColour(0, 0, 0, 0)) << &c - cases;
    }
    EXPECT_FALSE(CompositeBitmap(wxBitmap(), base).IsOk());
    EXPECT_FALSE(CompositeBitmap(base, wxBitmap()).IsOk());
    EXPECT_EQ(base.ConvertToImage().GetAlpha(0, 0), 0) << "the base is left alone";
}

} // namespace
