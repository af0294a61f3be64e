// The frame's window icons and the pictures of the embedded image sets, by name.
#include "frame/Veltro3AppFrame.h"
#include "resources/IconBundle.h"
#include "resources/ImageSets.h"

#include <gtest/gtest.h>
#include <wx/xrc/xmlres.h>

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

TEST(ImageSets, EveryPictureLoadsByNameAtItsSize)
{
    EnsureLauncherImages();
    EnsureHelpImages();
    EnsureCommonImages();
    std::vector<std::pair<wxString, wxSize>> pictures = {
        {"SplashAboutMainApp", {443, 454}}, {"SplashMainApp", {445, 425}},
        {"LauncherBG", {566, 345}},         {"HighlightBackground", {152, 58}},
        {"HighlightPressed", {152, 58}},    {"Help", {24, 24}}};
    for (const char* module : {"Monitor", "Printer", "LinkStudio", "Inspector", "Edit", "Verifier"})
        for (const char* state : {"", "Active", "Selected"})
            pictures.push_back({wxString(module) + "Module" + state, {48, 48}});
    for (auto& p : pictures)
        p.first = "Veltro2AppFrame::" + p.first;
    pictures.push_back({"Helper::ModuleSplash", {440, 100}});
    for (const auto& p : pictures) {
        const wxBitmap bitmap = wxXmlResource::Get()->LoadBitmap(p.first);
        EXPECT_TRUE(bitmap.IsOk() && bitmap.ConvertToImage().HasAlpha()) << p.first;
        EXPECT_EQ(bitmap.GetSize(), p.second) << p.first;
    }
}
