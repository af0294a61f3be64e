// The window icons: icon images decoded from the executable's resources, and the frame's
// icons as each system makes them from the group.
#include "frame/Veltro3AppFrame.h"
#include "platform/IconResource.h"
#include "resources/IconBundle.h"

#include <gtest/gtest.h>

#include <vector>

using Bytes = std::vector<unsigned char>;

TEST(IconResource, DecodesBitmapsAndRejectsShortOrOversizedOnes)
{
    // 2 x 2 at 8 bits: two palette colours (BGRx), rows bottom first, mask bits last.
    Bytes dib(40, 0);
    dib[0] = 40, dib[4] = 2, dib[8] = 4, dib[12] = 1, dib[14] = 8, dib[32] = 2;
    dib.insert(dib.end(), {0, 0, 255, 0, 255, 0, 0, 0}); // red, blue
    dib.insert(dib.end(), {1, 0, 0, 0, 0, 1, 0, 0});     // bottom: blue red, top: red blue
    dib.insert(dib.end(), {0, 0, 0, 0, 0x40, 0, 0, 0});  // top right pixel transparent
    const IconImage image = DecodeIconImage(dib.data(), dib.size());
    EXPECT_EQ(image.rgba, (Bytes{255, 0, 0, 255, 0, 0, 255, 0, 0, 0, 255, 255, 255, 0, 0, 255}));
    EXPECT_EQ(DecodeIconImage(dib.data(), dib.size() - 1).kind, IconImage::Kind::Invalid);
    dib[5] = 0x7F; // far wider than any icon
    EXPECT_EQ(DecodeIconImage(dib.data(), dib.size()).kind, IconImage::Kind::Invalid);
}

TEST(IconBundle, FrameCarriesTheNineTrueColourIcons)
{
    Veltro3AppFrame* frame = new Veltro3AppFrame("Veltrona", wxDefaultPosition, wxDefaultSize);
    const wxIconBundle icons = frame->GetIcons();
    frame->Destroy();
    EXPECT_EQ(icons.GetIconCount(), 9u);
    for (int side : {16, 32, 48, 64, 72, 80, 96, 128, 256})
        EXPECT_TRUE(icons.GetIcon(wxSize(side, side), wxIconBundle::FALLBACK_NONE).IsOk()) << side;
    EXPECT_EQ(LoadIconBundle("IDI_ICON1", 8).GetIconCount(), 3u);
}
