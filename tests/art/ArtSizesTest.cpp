// The rendered artwork: every picture at the exact size the layout is built on,
// with alpha, and the icon file's twelve images in their sizes and bit depths.
#include <gtest/gtest.h>
#include <wx/image.h>

#include <fstream>
#include <iterator>

TEST(ArtSizesTest, PicturesAndIconImagesHaveTheirSizes)
{
    wxInitAllImageHandlers();
    const wxString dir = VELTRONA_TEST_ART_DIR;
    const std::pair<wxSize, std::vector<const char*>> kPictures[] = {
        {{443, 454}, {"Images_splash_About_graphic"}},
        {{445, 425}, {"Images_splash_graphic"}},
        {{566, 345}, {"Images_launcher_graphic"}},
        {{152, 58}, {"Images_highlight_bg", "Images_highlight_pressed"}},
        {{24, 24}, {"Images_help_24x24"}},
        {{440, 100}, {"images_modulesplash_zel"}},
        {{48, 48},
         {"monitor_normal", "monitor_active", "monitor_pressed", "printer_normal", "printer_active",
          "printer_pressed", "devicelink_normal", "devicelink_active", "devicelink_pressed",
          "inpect_normal", "inspect_active", "inspect_pressed", "edit_normal", "edit_active",
          "edit_pressed", "verifier_normal", "verifier_active", "verifier_pressed"}}};
    for (const auto& [size, files] : kPictures)
        for (const char* file : files) {
            const wxImage image(dir + "/" + file + ".png", wxBITMAP_TYPE_PNG);
            EXPECT_EQ(image.GetSize(), size) << file;
            EXPECT_TRUE(image.HasAlpha()) << file;
        }

    // The directory entries, which the frame picks images by, then each image decoded.
    std::ifstream in((dir + "/Veltrona.ico").fn_str(), std::ios::binary);
    const std::string ico{std::istreambuf_iterator<char>(in), {}};
    ASSERT_EQ(ico.substr(0, 6), std::string("\0\0\1\0\14\0", 6)) << "an icon file of 12 images";
    const int kSizes[] = {48, 32, 16, 256, 128, 96, 80, 72, 64, 48, 32, 16};
    for (int i = 0; i < 12; ++i) {
        const int size = kSizes[i], bits = i < 3 ? 8 : 32;
        SCOPED_TRACE(testing::Message() << "image " << i);
        const char side = char(size % 256); // 256 is stored as 0
        EXPECT_EQ(ico.substr(6 + 16 * i, 8), std::string({side, side, 0, 0, 1, 0, char(bits), 0}));
        const wxImage image(dir + "/Veltrona.ico", wxBITMAP_TYPE_ICO, i);
        EXPECT_EQ(image.GetSize(), wxSize(size, size));
        EXPECT_EQ(image.HasAlpha(), bits == 32);
    }
}
