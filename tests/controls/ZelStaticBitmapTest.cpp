// The image button driven by real pointer events on a real window.
#include "controls/ZelStaticBitmap.h"

#include "support/DesktopTools.h"
#include "support/GuiWait.h"

#include <gtest/gtest.h>
#include <wx/frame.h>
#include <wx/image.h>
#include <wx/panel.h>
#include <wx/uiaction.h>

#include <string>

namespace {

wxBitmap Solid(const wxColour& colour)
{
    wxImage image(60, 40);
    image.SetRGB(wxRect(0, 0, 60, 40), colour.Red(), colour.Green(), colour.Blue());
    return wxBitmap(image);
}

TEST(ZelStaticBitmapTest, FollowsThePointer)
{
    auto* frame = new wxFrame(nullptr, wxID_ANY, "button", wxPoint(100, 100), wxSize(300, 200));
    auto* button = new ZelStaticBitmap(new wxPanel(frame), 1101, Solid(*wxBLUE), wxPoint(20, 20),
                                       wxDefaultSize, wxNO_BORDER);
    button->SetBitmapHover(Solid(*wxGREEN));
    button->SetBitmapPressed(Solid(*wxRED));
    int clicks = 0;
    frame->Bind(wxEVT_BUTTON, [&](wxCommandEvent& e) { clicks += e.GetId() == 1101; });
    frame->Show();
    ASSERT_TRUE(WaitFor([&] {
        const wxImage screen = ScreenPixels(button->GetScreenRect());
        return screen.GetBlue(30, 20) == 255 && screen.GetGreen(30, 20) == 0;
    }));

    // Each step: i move in, o move out, d press, u release, 2 double click, h hide and
    // show (breaks the grab); then the state it leads to (0 normal, 1 hover, 2 pressed).
    const std::pair<std::string, int> cases[] = {
        {"i1 d2 o0 u0", 0}, {"i1 d2 o0 i2 u1", 1}, {"i1 21", 2}, {"i1 d2 h0 u0", 0}};
    wxUIActionSimulator sim;
    int x = 5;
    auto step = [&](char action, int state) {
        const wxRect r = button->GetScreenRect();
        if (action == 'i' || action == 'o')
            sim.MouseMove((action == 'i' ? r.GetLeft() : r.GetRight() + 50) + x, r.GetTop() + 20);
        else if (action == 'd')
            sim.MouseDown();
        else if (action == 'u')
            sim.MouseUp();
        else if (action == '2')
            sim.MouseDblClick();
        else
            button->Hide(), button->Show();
        return WaitFor([&] { return button->GetState() == state; });
    };
    for (const auto& [steps, expectedClicks] : cases) {
        // Presses of successive cases lie apart, so none makes a double click.
        x += 9;
        clicks = 0;
        for (size_t i = 0; i < steps.size(); i += 3)
            EXPECT_TRUE(step(steps[i], steps[i + 1] - '0')) << steps << ": step " << i / 3;
        // Moving in and out again flushes every event the case caused.
        step('i', 1);
        step('o', 0);
        EXPECT_EQ(clicks, expectedClicks) << steps;
    }
    frame->Destroy();
}

} // namespace
