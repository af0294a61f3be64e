// The main frame: its menus, its fixed size and how it closes.
#include "frame/Veltro3AppFrame.h"

#include "support/DialogRecorder.h"
#include "support/GuiWait.h"

#include <gtest/gtest.h>
#include <wx/menu.h>
#include <wx/weakref.h>

namespace {

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

TEST(FrameTest, MenusFixedSizeAndExitWithoutAsking)
{
    DialogRecorder dialogs;
    auto* frame = new Veltro3AppFrame("Veltrona", wxDefaultPosition, wxDefaultSize);
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

    frame->Show();
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
