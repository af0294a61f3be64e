// The launcher view as a user sees it: the pixels on the screen, the buttons
// under a real pointer, the processes a click starts.
#include "controls/TextBitmap.h"
#include "controls/ZelStaticBitmap.h"
#include "frame/Veltro3AppFrame.h"
#include "frame/Veltro3MainAppStandardView.h"

#include "support/DesktopTools.h"
#include "support/GuiWait.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gtest/gtest.h>
#include <wx/uiaction.h>
#include <wx/utils.h>

#include <memory>

namespace {

wxImage Grab(wxWindow* window)
{
    return ScreenPixels(window->GetScreenRect());
}

// Whether the screen shows `image` drawn over `background` at every pixel
// (off by a little at most, for rounding in the toolkit's blending).
bool Shows(const wxImage& screen, const wxBitmap& image, const wxColour& background)
{
    wxImage back(image.GetWidth(), image.GetHeight());
    back.SetRGB(wxRect(back.GetSize()), background.Red(), background.Green(), background.Blue());
    const wxImage expected = CompositeBitmap(wxBitmap(back), image).ConvertToImage();
    if (screen.GetSize() != expected.GetSize())
        return false;
    const unsigned char* a = screen.GetData();
    const unsigned char* b = expected.GetData();
    for (long i = 0; i < 3L * screen.GetWidth() * screen.GetHeight(); ++i)
        if (std::abs(a[i] - b[i]) > 3)
            return false;
    return true;
}

// The left-most column of the label's dark ink right of the icon.
int LabelStart(const wxImage& image)
{
    for (int x = 60; x < image.GetWidth(); ++x)
        for (int y = 0; y < image.GetHeight(); ++y)
            if (image.GetAlpha(x, y) > 128 && image.GetRed(x, y) < 100)
                return x;
    return -1;
}

class LauncherViewTest : public testing::Test
{
protected:
    void SetUp() override
    {
        m_frame = new Veltro3AppFrame("Veltrona", wxPoint(50, 50), wxDefaultSize);
        m_view = m_frame->GetStandardView();
        m_frame->Show();
        // Placed by the window manager and painted: the screen shows a button.
        ZelStaticBitmap* printer = Button(1101);
        ASSERT_TRUE(WaitFor([&] {
            return Shows(Grab(printer), printer->GetBitmap(), printer->GetBackgroundColour());
        }));
    }
    // The next test's window must not find this one still under the pointer.
    void TearDown() override
    {
        bool gone = false;
        m_frame->Bind(wxEVT_DESTROY, [&](wxWindowDestroyEvent& e) {
            gone = gone || e.GetEventObject() == m_frame;
            e.Skip();
        });
        m_frame->Destroy();
        EXPECT_TRUE(WaitFor([&] { return gone; }));
    }

    ZelStaticBitmap* Button(int id)
    {
        return static_cast<ZelStaticBitmap*>(m_view->FindWindow(id));
    }

    void PointAt(wxWindow* window)
    {
        const wxRect r = window->GetScreenRect();
        m_sim.MouseMove(r.GetLeft() + r.width / 2, r.GetTop() + r.height / 2);
    }

    Veltro3AppFrame* m_frame = nullptr;
    Veltro3MainAppStandardView* m_view = nullptr;
    wxUIActionSimulator m_sim;
};

TEST_F(LauncherViewTest, LayoutAndPixels)
{
    EXPECT_EQ(m_view->GetSize(), wxSize(564, 344));
    const struct
    {
        int id;
        wxPoint at;
        bool dropTarget;
    } places[] = {
        {1101, {228, 68}, false}, {1100, {228, 155}, false}, {1102, {228, 237}, false},
        {1104, {405, 68}, true},  {1103, {405, 155}, false}, {1105, {405, 237}, false},
        {1106, {10, 304}, false},
    };
    for (const auto& p : places) {
        ZelStaticBitmap* button = Button(p.id);
        ASSERT_TRUE(button) << p.id;
        EXPECT_EQ(button->GetPosition(), p.at) << p.id;
        EXPECT_EQ(button->GetDropTarget() != nullptr, p.dropTarget) << p.id;
        EXPECT_EQ(button->GetCursor().IsOk(), p.id != 1106) << "hand cursor on modules only";
        if (p.id != 1106) {
            EXPECT_EQ(button->GetSize(), wxSize(152, 58)) << p.id;
        }
    }
    EXPECT_FALSE(m_view->GetDropTarget());

    // A system colour change gives Inspect and Edit the view colour again.
    Button(1104)->SetBackgroundColour(*wxRED);
    Button(1103)->SetBackgroundColour(*wxRED);
    wxSysColourChangedEvent changed;
    m_view->ProcessWindowEvent(changed);
    EXPECT_EQ(Button(1104)->GetBackgroundColour(), wxColour(224, 223, 227));
    EXPECT_EQ(Button(1103)->GetBackgroundColour(), wxColour(224, 223, 227));

    // The column titles are drawn dark over the light picture.
    ASSERT_TRUE(WaitFor([&] {
        const wxImage view = Grab(m_view);
        for (int x = 250; x < 330; ++x)
            if (view.GetRed(x, 30) < 80)
                return true;
        return false;
    }));

    // Normal, hover and pressed look on the screen, under a real pointer.
    ZelStaticBitmap* printer = Button(1101);
    const wxColour colour = printer->GetBackgroundColour();
    EXPECT_EQ(colour, wxColour(224, 223, 227));
    PointAt(printer);
    EXPECT_TRUE(WaitFor([&] { return Shows(Grab(printer), printer->GetBitmapHover(), colour); }));
    m_sim.MouseDown();
    EXPECT_TRUE(WaitFor([&] { return Shows(Grab(printer), printer->GetBitmapPressed(), colour); }));
    m_sim.MouseMove(m_view->GetScreenPosition() + wxPoint(5, 100));
    m_sim.MouseUp();
    EXPECT_TRUE(WaitFor([&] { return Shows(Grab(printer), printer->GetBitmap(), colour); }))
        << printer->GetState() << printer->HasCapture();

    // The hover image has the highlight behind icon and label; the pressed
    // label sits one pixel further left.
    const wxImage normal = printer->GetBitmap().ConvertToImage();
    const wxImage hover = printer->GetBitmapHover().ConvertToImage();
    const wxImage pressed = printer->GetBitmapPressed().ConvertToImage();
    EXPECT_EQ(normal.GetAlpha(100, 4), 0);
    EXPECT_GT(hover.GetAlpha(100, 4), 100);
    EXPECT_GT(hover.GetAlpha(30, 50), 100) << "below the icon";
    EXPECT_GT(LabelStart(hover), 60);
    EXPECT_EQ(LabelStart(pressed), LabelStart(hover) - 1);
}

TEST_F(LauncherViewTest, RealClicksStartModules)
{
    StandinDir install({"Quenta Print Studio.exe", "Monitor/Zel Display Studio.exe",
                        "Quenta Link Studio.exe", "ZelVerifyStudio.exe",
                        "Quenta Inspect Studio.exe", "Quenta Edit Studio.exe"});
    const std::string log = install.Path() + "/starts.log";
    setenv("VELTRONA_STANDIN_LOG", log.c_str(), 1);
    setenv("VELTRONA_STANDIN_EXIT", "1", 1);
    wxSetWorkingDirectory(install.Path());
    int helpClicks = 0;
    m_frame->Bind(wxEVT_BUTTON, [&](wxCommandEvent& e) {
        helpClicks += e.GetId() == 1106;
        e.Skip();
    });

    const struct
    {
        int id;
        const char* exe;
    } buttons[] = {
        {1101, "Quenta Print Studio.exe"},   {1100, "Monitor/Zel Display Studio.exe"},
        {1102, "Quenta Link Studio.exe"},    {1105, "ZelVerifyStudio.exe"},
        {1104, "Quenta Inspect Studio.exe"}, {1103, "Quenta Edit Studio.exe"},
    };
    size_t started = 0;
    for (const auto& b : buttons) {
        PointAt(Button(b.id));
        m_sim.MouseClick();
        const auto records = WaitForRecords(log, ++started);
        ASSERT_EQ(records.size(), started) << b.exe;
        EXPECT_EQ(records.back().exe, install.Path() + "/" + b.exe);
    }
    PointAt(Button(1106));
    m_sim.MouseClick();
    EXPECT_TRUE(WaitFor([&] { return helpClicks == 1; }));
    EXPECT_EQ(SettledRecords(log).size(), started);
}

} // namespace
