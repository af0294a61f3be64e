// The splash and About windows on the real display: when they close, how the text scrolls.
#include "about/Splash.h"
#include "about/SplashScreen.h"
#include "platform/ScreenCapture.h"
#include "support/DesktopTools.h"
#include "support/GuiWait.h"

#include <gtest/gtest.h>

#include <wx/uiaction.h>

#include <chrono>

namespace {

using Clock = std::chrono::steady_clock;

ZelSplashScreen* OpenSplash()
{
    for (wxWindow* window : wxTopLevelWindows)
        if (auto* splash = dynamic_cast<ZelSplashScreen*>(window))
            if (!splash->IsBeingDeleted() && splash->IsShown())
                return splash;
    return nullptr;
}

long MsSince(Clock::time_point start)
{
    return long(
        std::chrono::duration_cast<std::chrono::milliseconds>(Clock::now() - start).count());
}

} // namespace

// The start-up splash ignores presses and keys and closes when its time is up; the About
// box closes at the first press, key or loss of activation.
TEST(Splash, StartupSplashIgnoresInputWhereTheAboutBoxCloses)
{
    auto* other = new wxFrame(nullptr, wxID_ANY, "Other launcher window", {10, 10}, {200, 150});
    other->Show();
    wxUIActionSimulator input;
    for (const bool startup : {true, false})
        for (const std::string action : {"press", "key", "activation"}) {
            SCOPED_TRACE(action + (startup ? " on the splash" : " on the About box"));
            // The user opens the About box from the menu, after input the window manager sees.
            input.MouseMove(60, 80);
            input.MouseClick();
            const auto start = Clock::now();
            ShowSplash(startup, startup ? 2000 : 5000);
            ZelSplashScreen* splash = OpenSplash();
            ASSERT_NE(splash, nullptr);
            if (startup) {
                EXPECT_EQ(splash->GetScreenRect(),
                          wxRect((1280 - 445) / 2, (1024 - 425) / 2, 445, 425));
            } else {
                ASSERT_TRUE(WaitFor([&] { return splash->IsActive(); }));
            }
            // A grab by the splash would take other programs' clicks.
            EXPECT_EQ(splash->HasCapture(), !startup);
            if (action == "key") {
                input.Char('x');
            } else if (action == "activation") {
                other->Raise();
                other->SetFocus();
            } else {
                input.MouseMove(splash->GetScreenRect().GetTopLeft() + wxPoint(100, 100));
                input.MouseClick();
            }
            ASSERT_TRUE(WaitFor([] { return OpenSplash() == nullptr; }));
            EXPECT_EQ(MsSince(start) >= 2000, startup) << MsSince(start) << " ms";
            EXPECT_EQ(wxWindow::GetCapture(), nullptr);
        }
    other->Destroy();
}

// A plain picture (no alpha, so no blend) and four short lines: the text, about 50 pixels
// high, wraps in a 28-pixel window within a few seconds.
TEST(Splash, AboutTextStandsStillThenRisesAndWrapsWithoutGap)
{
    wxImage blue(300, 200);
    blue.SetRGB(wxRect(0, 0, 300, 200), 0, 0, 255);
    const wxArrayString lines = wxSplit("First line\nSecond line\nThird line\nFourth line", '\n');
    const auto start = Clock::now();
    auto* about = new ZelAboutSplashScreen(-1, false, 3000, wxBitmap(blue), lines, {150, 100}, 17,
                                           20, *wxWHITE, true);
    const wxRect area = about->GetScreenRect();
    const int top = 100 - 28 / 2, height = 4 * 7;
    wxImage before;
    ASSERT_TRUE(WaitFor([&] {
        before = CaptureScreen(area);
        return before.GetBlue(2, 2) == 255 && before.GetRed(2, 2) == 0;
    }));
    const wxRect lowest(0, top + height - 10, area.width, 10);
    ASSERT_TRUE(SamePixels(before.GetSubImage(lowest), blue.GetSubImage(lowest), 0))
        << "lowest rows show the picture";

    int wrapped = 0;
    for (int changes = 0; changes < 60; ++changes) {
        wxImage now;
        ASSERT_TRUE(WaitFor([&] {
            now = CaptureScreen(area);
            return !SamePixels(now, before, 0);
        })) << "the text stopped after "
            << changes << " moves";
        if (changes == 0) {
            EXPECT_GE(MsSince(start), 3000) << "the text stands still at first";
        }
        bool shifted = false;
        const wxRect rows(0, top, area.width, height - 11);
        for (int shift = 1; shift < 4 && !shifted; ++shift)
            shifted =
                SamePixels(now.GetSubImage(rows),
                           before.GetSubImage(wxRect(0, top + shift, area.width, height - 11)), 0);
        EXPECT_TRUE(shifted) << "every move is an upward shift of the same text";
        wrapped += now.GetBlue(area.width / 2, top + height - 5) != 255 ||
                   now.GetRed(area.width / 2, top + height - 5) != 0;
        before = now;
    }
    about->Close();
    EXPECT_GT(wrapped, 0) << "past the end the first line follows at once";
}
