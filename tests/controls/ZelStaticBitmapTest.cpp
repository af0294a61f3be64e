// The image button driven by real pointer events on a real window.
#include "controls/ZelStaticBitmap.h"

#include "support/DesktopTools.h"
#include "support/GuiWait.h"

#include <gtest/gtest.h>
#include <wx/frame.h>
#include <wx/image.h>
#include <wx/panel.h>
#include <wx/uiaction.h>

#include <vector>

namespace {

wxBitmap Solid(int w, int h, const wxColour& colour)
{
    wxImage image(w, h);
    image.SetRGB(wxRect(0, 0, w, h), colour.Red(), colour.Green(), colour.Blue());
    return wxBitmap(image);
}

enum Action
{
    IN,
    OUT,
    DOWN,
    UP,
    DCLICK,
    HIDE_SHOW
};

// An action and the state the button is in once it has been handled.
struct Step
{
    Action action;
    int state;
};

struct Case
{
    const char* name;
    std::vector<Step> steps;
    int clicks;
};

TEST(ZelStaticBitmapTest, FollowsThePointer)
{
    auto* frame = new wxFrame(nullptr, wxID_ANY, "button", wxPoint(100, 100), wxSize(300, 200));
    auto* button = new ZelStaticBitmap(new wxPanel(frame), 1101, Solid(60, 40, *wxBLUE),
                                       wxPoint(20, 20), wxDefaultSize, wxNO_BORDER);
    button->SetBitmapHover(Solid(60, 40, *wxGREEN));
    button->SetBitmapPressed(Solid(60, 40, *wxRED));
    int clicks = 0;
    frame->Bind(wxEVT_BUTTON, [&](wxCommandEvent& e) { clicks += e.GetId() == 1101; });
    frame->Show();
    // Placed by the window manager and painted where the pointer will go.
    ASSERT_TRUE(WaitFor([&] {
        const wxImage screen = ScreenPixels(button->GetScreenRect());
        return screen.GetBlue(30, 20) == 255 && screen.GetGreen(30, 20) == 0;
    }));

    const Case cases[] = {
        {"press, drag out, release outside", {{IN, 1}, {DOWN, 2}, {OUT, 0}, {UP, 0}}, 0},
        {"press, out and back in, release inside",
         {{IN, 1}, {DOWN, 2}, {OUT, 0}, {IN, 2}, {UP, 1}},
         1},
        {"double click", {{IN, 1}, {DCLICK, 1}}, 2},
        {"grab broken while pressed", {{IN, 1}, {DOWN, 2}, {HIDE_SHOW, 0}, {UP, 0}}, 0},
    };
    wxUIActionSimulator sim;
    int x = 5;
    auto act = [&](Action action) {
        const wxRect r = button->GetScreenRect();
        switch (action) {
        case IN:
            sim.MouseMove(r.GetLeft() + x, r.GetTop() + 20);
            break;
        case OUT:
            sim.MouseMove(r.GetRight() + 50 + x, r.GetTop() + 20);
            break;
        case DOWN:
            sim.MouseDown();
            break;
        case UP:
            sim.MouseUp();
            break;
        case DCLICK:
            sim.MouseDblClick();
            break;
        case HIDE_SHOW:
            button->Hide();
            button->Show();
            break;
        }
    };
    for (const Case& c : cases) {
        // Presses of successive cases lie apart, so none makes a double click.
        x += 9;
        clicks = 0;
        for (const Step& step : c.steps) {
            act(step.action);

            EXPECT_TRUE(WaitFor([&] { return button->GetState() == step.state; }))
                << c.name << ": step " << step.action;
        }
        // Moving in and out again flushes every event the case caused.
        for (const Step& step : {Step{IN, 1}, Step{OUT, 0}}) {
            act(step.action);

            WaitFor([&] { return button->GetState() == step.state; });
        }
        EXPECT_EQ(clicks, c.clicks) << c.name;
    }
    // A press elsewhere grabs the pointer for that window, so X sends the
    // button no crossing; should one come, it shows hover, not pressed.
    wxMouseEvent enter(wxEVT_ENTER_WINDOW);
    enter.SetLeftDown(true);
    button->ProcessWindowEvent(enter);
    EXPECT_EQ(button->GetState(), 1);
    frame->Destroy();
}

TEST(ZelStaticBitmapTest, SizeAndFocus)
{
    auto* frame = new wxFrame(nullptr, wxID_ANY, "button");
    auto* framed = new ZelStaticBitmap(frame, wxID_ANY, Solid(24, 24, *wxBLUE), wxDefaultPosition,
                                       wxDefaultSize, ZSB_FRAMED);
    auto* plain = new ZelStaticBitmap(frame, wxID_ANY, wxBitmap());
    EXPECT_EQ(framed->GetBestSize(), wxSize(28, 30));
    EXPECT_TRUE(framed->HasFlag(wxNO_BORDER));
    EXPECT_EQ(plain->GetBestSize(), wxSize(0, 0));
    EXPECT_FALSE(framed->AcceptsFocusFromKeyboard());

    framed->SetBackgroundColour(*wxWHITE);
    EXPECT_EQ(framed->GetBitmapDisabled().ConvertToImage().GetRed(0, 0), 127)
        << "re-derived toward the new colour";
    framed->SetBitmapDisabled(Solid(24, 24, *wxGREEN));
    framed->SetBackgroundColour(*wxBLACK);
    EXPECT_EQ(framed->GetBitmapDisabled().ConvertToImage().GetGreen(0, 0), 255);
    frame->Destroy();
}

} // namespace
