// The frame's window icons, from the embedded icon group.
#include "frame/Veltro3AppFrame.h"
#include "resources/IconBundle.h"

#include <gtest/gtest.h>

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
