// The launcher's frame as a user sees it: the pixels on the screen, the buttons under a
// real pointer, the processes a click starts, the menus, how it closes.
#include "controls/TextBitmap.h"
#include "controls/ZelStaticBitmap.h"
#include "frame/Veltro3AppFrame.h"
#include "frame/Veltro3MainAppStandardView.h"

#include "support/DesktopTools.h"
#include "support/DialogRecorder.h"
#include "support/GuiWait.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gtest/gtest.h>
#include <wx/menu.h>
#include <wx/uiaction.h>
#include <wx/utils.h>
#include <wx/weakref.h>

#include <string>
#include <tuple>

namespace {

// Whether the screen shows `image` over the button's background, give or take rounding.
bool Shows(ZelStaticBitmap* button, const wxBitmap& image)
{
    const wxColour bg = button->GetBackgroundColour();
    wxImage back(image.GetWidth(), image.GetHeight());
    back.SetRGB(wxRect(back.GetSize()), bg.Red(), bg.Green(), bg.Blue());
    return SamePixels(ScreenPixels(button->GetScreenRect()),
                      CompositeBitmap(wxBitmap(back), image).ConvertToImage());
}

// "|id label" per item, "|-" for a separator, a submenu's items in brackets.
wxString Describe(const wxMenu* menu)
{
    wxString text;
    for (const wxMenuItem* item : menu->GetMenuItems()) {
        text += item->IsSeparator()
                    ? wxString("|-")
                    : wxString::Format("|%d ", item->GetId()) + item->GetItemLabel();
        if (item->GetSubMenu())
            text += "[" + Describe(item->GetSubMenu()) + "]";
    }
    return text;
}

TEST(LauncherViewTest, LooksStartsModulesAndExits)
{
    DialogRecorder dialogs;
    StandinDir install({"Quenta Print Studio.exe", "Monitor/Zel Display Studio.exe",
                        "Quenta Link Studio.exe", "ZelVerifyStudio.exe",
                        "Quenta Inspect Studio.exe", "Quenta Edit Studio.exe"});
    const std::string log = install.Path() + "/starts.log";
    setenv("VELTRONA_STANDIN_LOG", log.c_str(), 1);
    setenv("VELTRONA_STANDIN_EXIT", "1", 1);
    wxSetWorkingDirectory(install.Path());

    auto* frame = new Veltro3AppFrame("Veltrona", wxPoint(50, 50), wxDefaultSize);
    Veltro3MainAppStandardView* view = frame->GetStandardView();
    auto button = [&](int id) { return static_cast<ZelStaticBitmap*>(view->FindWindow(id)); };
    ZelStaticBitmap* printer = button(1101);
    frame->Show();
    ASSERT_TRUE(WaitFor([&] { return Shows(printer, printer->GetBitmap()); }));
    EXPECT_FALSE(view->GetDropTarget());

    // Icon in every look; the highlight behind icon and label only under the pointer.
    const wxImage normal = printer->GetBitmap().ConvertToImage();
    EXPECT_GT(normal.GetAlpha(30, 26), 100);
    EXPECT_EQ(normal.GetAlpha(30, 52), 0);
    EXPECT_GT(printer->GetBitmapHover().ConvertToImage().GetAlpha(30, 52), 100);

    wxUIActionSimulator sim;
    // A real click starts each module as its menu command does; Help's reaches the frame.
    int helpClicks = 0;
    frame->Bind(wxEVT_BUTTON, [&](wxCommandEvent& e) {
        helpClicks += e.GetId() == 1106;
        e.Skip();
    });
    const std::vector<std::string> verifyArgs = {"VLT", std::to_string(GetModuleLanguageId())};
    const struct
    {
        int id, menu;
        wxPoint at;
        const char* exe;
        std::vector<std::string> args;
    } buttons[] = {
        {1101, 1001, {228, 68}, "Quenta Print Studio.exe", {}},
        {1100, 1002, {228, 155}, "Monitor/Zel Display Studio.exe", {}},
        {1102, 1003, {228, 237}, "Quenta Link Studio.exe", {}},
        {1104, 1005, {405, 68}, "Quenta Inspect Studio.exe", {}},
        {1103, 1006, {405, 155}, "Quenta Edit Studio.exe", {}},
        {1105, 1004, {405, 237}, "ZelVerifyStudio.exe", verifyArgs},
        {1106, 0, {10, 304}, nullptr, {}},
    };
    size_t started = 0;
    for (const auto& b : buttons) {
        ZelStaticBitmap* target = button(b.id);
        ASSERT_TRUE(target) << b.id;
        EXPECT_EQ(target->GetRect(), wxRect(b.at, b.exe ? wxSize(152, 58) : wxSize(28, 30)));
        EXPECT_EQ(target->GetDropTarget() != nullptr, b.id == 1104) << "only Inspect takes drops";
        const wxRect r = target->GetScreenRect();
        sim.MouseMove(r.GetLeft() + r.width / 2, r.GetTop() + r.height / 2);
        sim.MouseClick();
        if (!b.exe)
            continue;
        ASSERT_EQ(WaitForRecords(log, ++started).size(), started) << b.exe;
        frame->ProcessCommand(b.menu);
        const auto records = WaitForRecords(log, ++started);
        ASSERT_EQ(records.size(), started) << b.exe;
        for (size_t i = started - 2; i < started; ++i)
            EXPECT_EQ(std::tie(records[i].exe, records[i].args, records[i].cwd),
                      std::make_tuple(install.Path() + "/" + b.exe, b.args, install.Path()));
    }
    EXPECT_TRUE(WaitFor([&] { return helpClicks == 1; }));
    EXPECT_EQ(SettledRecords(log).size(), started);

    // Steps: i move in, o move out, d press, u release, 2 double click, h hide and show
    // (breaks the grab); each with the state it leads to (0 normal, 1 hover, 2 pressed),
    // which the screen shows; then the clicks (modules started) it made.
    const std::pair<std::string, size_t> cases[] = {
        {"i1 d2 o0 u0", 0}, {"i1 d2 o0 i2 u1", 1}, {"i1 21", 2}, {"i1 d2 h0 u0", 0}};
    const wxBitmap looks[] = {printer->GetBitmap(), printer->GetBitmapHover(),
                              printer->GetBitmapPressed()};
    int x = -6;
    auto step = [&](char action, int state) {
        const wxRect r = printer->GetScreenRect();
        if (action == 'i' || action == 'o')
            sim.MouseMove((action == 'i' ? r.GetLeft() : r.GetRight() + 50) + x, r.GetTop() + 15);
        else if (action == 'd')
            sim.MouseDown();
        else if (action == 'u')
            sim.MouseUp();
        else if (action == '2')
            sim.MouseDblClick();
        else
            printer->Hide(), printer->Show();
        if (WaitFor([&] { return printer->GetState() == state && Shows(printer, looks[state]); }))
            return std::string();
        // What it came to instead, for a failure that shows up only on a busy machine.
        std::string shown = "none of the looks";
        for (int look = 0; look < 3; ++look)
            if (Shows(printer, looks[look]))
                shown = "look " + std::to_string(look);
        const wxPoint pointer = wxGetMousePosition();
        return "state " + std::to_string(printer->GetState()) + ", the screen shows " + shown +
               ", pointer at " + std::to_string(pointer.x) + "," + std::to_string(pointer.y) +
               " over " + std::to_string(r.x) + "," + std::to_string(r.y) +
               (printer->HasCapture() ? ", captured" : "") +
               (wxWindow::GetCapture() ? ", a window has the capture" : "");
    };
    for (const auto& [steps, clicks] : cases) {
        // Presses of successive cases lie apart, so none makes a double click.
        x += 10;
        for (size_t i = 0; i < steps.size(); i += 3)
            EXPECT_EQ(step(steps[i], steps[i + 1] - '0'), "") << steps << ": step " << i / 3;
        // The release is handled (the capture gone) before the pointer comes back.
        EXPECT_TRUE(WaitFor([&] { return !printer->HasCapture(); })) << steps;
        // Moving in and out again flushes every event the case caused.
        step('i', 1);
        step('o', 0);
        EXPECT_EQ(SettledRecords(log).size(), started += clicks) << steps;
    }

    const wxMenuBar* bar = frame->GetMenuBar();
    wxString menus;
    for (size_t i = 0; i < bar->GetMenuCount(); ++i)
        menus += bar->GetMenuLabel(i) + Describe(bar->GetMenu(i)) + "\n";
    EXPECT_EQ(menus,
              "&File|1001 Create &Printer Profile...|1002 Create &Monitor Profile..."
              "|1003 Create &Device Link Profile...|-|1005 &Inspect Profile..."
              "|1006 &Edit Profile...|1004 &Verify Color...|-|1007 E&xit\n"
              "&Help|1015 Veltrona &Help\tF1|1016 User &Guide|1017 User &Forum|1107 H&ow-To|-"
              "|1019 &About Veltrona|1023 About &Modules[|1025 Quenta Print Studio"
              "|1026 Zel Display Studio|1027 Quenta Link Studio|1028 Quenta Inspect Studio"
              "|1029 Quenta Edit Studio|1030 Zel Verify Studio]|-|1020 Check for &Updates...\n");
    // A fixed size, and Exit closes it without asking.
    const wxSize size = frame->GetSize();
    EXPECT_EQ(frame->GetWindowStyle() & (wxRESIZE_BORDER | wxMAXIMIZE_BOX | wxMINIMIZE_BOX),
              wxMINIMIZE_BOX);
    frame->SetSize(900, 700);
    EXPECT_EQ(frame->GetSize(), size);
    const wxWeakRef<wxFrame> alive(frame);
    frame->ProcessCommand(1007);
    EXPECT_FALSE(frame->IsShown());
    EXPECT_TRUE(WaitFor([&] { return !alive; }));
    EXPECT_TRUE(dialogs.Dialogs().empty());
}

} // namespace
