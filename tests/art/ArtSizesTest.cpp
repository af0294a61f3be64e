// Checks the rendered artwork against the layout built on it: exact picture sizes
// with alpha, quiet areas where the program draws, and the icon file's images.

#include <gtest/gtest.h>
#include <wx/image.h>

#include <cstdint>
#include <cstdlib>
#include <fstream>
#include <iterator>
#include <vector>

namespace {

const wxString kArtDir = VELTRONA_TEST_ART_DIR;

wxImage LoadArt(const wxString& file, wxBitmapType type = wxBITMAP_TYPE_PNG, int index = -1)
{
    if (!wxImage::FindHandler(wxBITMAP_TYPE_PNG))
        wxImage::AddHandler(new wxPNGHandler);
    if (!wxImage::FindHandler(wxBITMAP_TYPE_ICO))
        wxImage::AddHandler(new wxICOHandler);
    wxImage img;
    img.LoadFile(kArtDir + "/" + file, type, index);
    return img;
}

// Where the program draws over a picture: text in light grey needs a dark ground,
// black text a light one, and a button an exact match of its background colour.
enum class Ground
{
    Dark,
    Light,
    Exact
};

struct Rgb
{
    int red, green, blue;
};

struct Area
{
    wxRect rect;
    Ground ground;
    Rgb colour;
};

struct Picture
{
    const char* file;
    int width, height;
    bool shaped;
    std::vector<Area> areas;
};

const Rgb kView{224, 223, 227};
const Rgb kHelpBack{218, 217, 221};

const std::vector<Picture> kPictures = {
    {"Images_splash_About_graphic.png", 443, 454, true, {{{48, 306, 348, 134}, Ground::Dark, {}}}},
    {"Images_splash_graphic.png", 445, 425, true, {{{48, 311, 300, 70}, Ground::Dark, {}}}},
    {"Images_launcher_graphic.png",
     566,
     345,
     false,
     {{{228, 68, 152, 58}, Ground::Exact, kView},
      {{228, 155, 152, 58}, Ground::Exact, kView},
      {{228, 237, 152, 58}, Ground::Exact, kView},
      {{405, 68, 152, 58}, Ground::Exact, kView},
      {{405, 155, 152, 58}, Ground::Exact, kView},
      {{405, 237, 152, 58}, Ground::Exact, kView},
      {{10, 304, 28, 30}, Ground::Exact, kHelpBack},
      {{250, 22, 120, 18}, Ground::Light, {}},
      {{418, 22, 130, 18}, Ground::Light, {}}}},
    {"monitor_normal.png", 48, 48, false, {}},
    {"monitor_active.png", 48, 48, false, {}},
    {"monitor_pressed.png", 48, 48, false, {}},
    {"printer_normal.png", 48, 48, false, {}},
    {"printer_active.png", 48, 48, false, {}},
    {"printer_pressed.png", 48, 48, false, {}},
    {"devicelink_normal.png", 48, 48, false, {}},
    {"devicelink_active.png", 48, 48, false, {}},
    {"devicelink_pressed.png", 48, 48, false, {}},
    {"inpect_normal.png", 48, 48, false, {}},
    {"inspect_active.png", 48, 48, false, {}},
    {"inspect_pressed.png", 48, 48, false, {}},
    {"edit_normal.png", 48, 48, false, {}},
    {"edit_active.png", 48, 48, false, {}},
    {"edit_pressed.png", 48, 48, false, {}},
    {"Images_highlight_bg.png", 152, 58, false, {}},
    {"Images_highlight_pressed.png", 152, 58, false, {}},
    {"verifier_normal.png", 48, 48, false, {}},
    {"verifier_active.png", 48, 48, false, {}},
    {"verifier_pressed.png", 48, 48, false, {}},
    {"Images_help_24x24.png", 24, 24, false, {}},
    {"images_modulesplash_zel.png", 440, 100, false, {{{140, 12, 290, 72}, Ground::Light, {}}}},
};

int Luma(const wxImage& img, int x, int y)
{
    return (30 * img.GetRed(x, y) + 59 * img.GetGreen(x, y) + 11 * img.GetBlue(x, y)) / 100;
}

TEST(ArtSizesTest, EveryPictureFitsTheLayout)
{
    for (const Picture& p : kPictures) {
        SCOPED_TRACE(p.file);
        const wxImage img = LoadArt(p.file);
        ASSERT_TRUE(img.IsOk());
        ASSERT_EQ(wxSize(p.width, p.height), img.GetSize());
        ASSERT_TRUE(img.HasAlpha());
        if (p.shaped) { // the transparent rim shapes the window
            EXPECT_EQ(0, img.GetAlpha(0, 0));
        }
        for (const Area& area : p.areas) {
            int faults = 0;
            for (int y = area.rect.GetTop(); y <= area.rect.GetBottom(); ++y)
                for (int x = area.rect.GetLeft(); x <= area.rect.GetRight(); ++x) {
                    const int luma = Luma(img, x, y);
                    const bool fits = area.ground == Ground::Dark ? luma < 80
                                      : area.ground == Ground::Light
                                          ? luma > 170
                                          : img.GetRed(x, y) == area.colour.red &&
                                                img.GetGreen(x, y) == area.colour.green &&
                                                img.GetBlue(x, y) == area.colour.blue;
                    faults += img.GetAlpha(x, y) != 255 || !fits;
                }
            EXPECT_EQ(0, faults) << "in area at " << area.rect.x << "," << area.rect.y;
        }
    }
}

unsigned Le16(const std::vector<uint8_t>& b, size_t at)
{
    return b.at(at) | b.at(at + 1) << 8;
}
uint32_t Le32(const std::vector<uint8_t>& b, size_t at)
{
    return Le16(b, at) | Le16(b, at + 2) << 16;
}

TEST(ArtSizesTest, IconFileHoldsTwelveImagesInOrder)
{
    std::ifstream in((kArtDir + "/Veltrona.ico").fn_str(), std::ios::binary);
    const std::vector<uint8_t> ico{std::istreambuf_iterator<char>(in), {}};
    ASSERT_GE(ico.size(), 6u);
    EXPECT_EQ(0u, Le16(ico, 0));
    EXPECT_EQ(1u, Le16(ico, 2));
    ASSERT_EQ(12u, Le16(ico, 4));

    const struct
    {
        int size, bits;
    } kImages[] = {{48, 8},  {32, 8},  {16, 8},  {256, 32}, {128, 32}, {96, 32},
                   {80, 32}, {72, 32}, {64, 32}, {48, 32},  {32, 32},  {16, 32}};
    for (int i = 0; i < 12; ++i) {
        const int size = kImages[i].size, bits = kImages[i].bits;
        SCOPED_TRACE(testing::Message()
                     << "image " << i << ": " << size << " px, " << bits << " bits");
        const size_t entry = 6 + 16 * i;
        EXPECT_EQ(size % 256, ico.at(entry));
        EXPECT_EQ(size % 256, ico.at(entry + 1));
        EXPECT_EQ(0, ico.at(entry + 2));
        EXPECT_EQ(1u, Le16(ico, entry + 4));
        EXPECT_EQ(unsigned(bits), Le16(ico, entry + 6));
        const uint32_t bytes = Le32(ico, entry + 8), offset = Le32(ico, entry + 12);
        ASSERT_LE(size_t(offset) + bytes, ico.size());
        const uint32_t colourRow = bits == 8 ? (size + 3) & ~3 : 4 * size;
        const uint32_t maskRow = (size + 31) / 32 * 4;
        EXPECT_EQ(40 + (bits == 8 ? 1024u : 0u) + (colourRow + maskRow) * size, bytes);
        EXPECT_EQ(40u, Le32(ico, offset));
        EXPECT_EQ(uint32_t(size), Le32(ico, offset + 4));
        EXPECT_EQ(uint32_t(2 * size), Le32(ico, offset + 8));
        EXPECT_EQ(unsigned(bits), Le16(ico, offset + 14));

        // The stored image shows the rendered one: exactly at 32 bits, closely at 8.
        const wxImage stored = LoadArt("Veltrona.ico", wxBITMAP_TYPE_ICO, i);
        const wxImage rendered = LoadArt(wxString::Format("app_icon_%d.png", size));
        ASSERT_TRUE(stored.IsOk() && rendered.IsOk());
        ASSERT_EQ(rendered.GetSize(), stored.GetSize());
        ASSERT_EQ(bits == 32, stored.HasAlpha());
        int faults = 0;
        for (int y = 0; y < size; ++y)
            for (int x = 0; x < size; ++x) {
                const int alpha = rendered.GetAlpha(x, y);
                const bool shown =
                    bits == 32 ? stored.GetAlpha(x, y) > 0 : !stored.IsTransparent(x, y);
                if (bits == 32 && stored.GetAlpha(x, y) != alpha)
                    ++faults;
                if (shown != (bits == 8 ? alpha >= 128 : alpha > 0))
                    ++faults;
                else if (shown && alpha >= 128) {
                    const int tolerance = bits == 8 ? 40 : 0;
                    faults +=
                        std::abs(stored.GetRed(x, y) - rendered.GetRed(x, y)) > tolerance ||
                        std::abs(stored.GetGreen(x, y) - rendered.GetGreen(x, y)) > tolerance ||
                        std::abs(stored.GetBlue(x, y) - rendered.GetBlue(x, y)) > tolerance;
                }
            }
        EXPECT_EQ(0, faults);
    }
}

} // namespace
