// The main frame: its menus, its fixed size and how it closes.
#include "frame/Veltro3AppFrame.h"
#include "frame/Veltro3MainAppStandardView.h"

#include "support/DialogRecorder.h"
#include "support/GuiWait.h"

#include <gtest/gtest.h>
#include <wx/menu.h>

namespace {

// One line per item: id and label, "-" for a separator, submenus indented.
std::vector<wxString> Describe(const wxMenu* menu, const wxString& indent = wxString())
{
    std::vector<wxString> lines;
    for (const wxMenuItem* item : menu->GetMenuItems()) {
        if (item->IsSeparator()) {
            lines.push_back(indent + "-");
            continue;
        }
        EXPECT_TRUE(item->GetHelp().empty());
        lines.push_back(indent + wxString::Format("%d ", item->GetId()) + item->GetItemLabel());
        if (item->GetSubMenu())
            for (const wxString& line : Describe(item->GetSubMenu(), indent + "  "))
                lines.push_back(line);
    }
    return lines;
}

TEST(FrameTest, MenusInOrder)
{
    auto* frame = new Veltro3AppFrame("Veltrona", wxDefaultPosition, wxDefaultSize);
    const wxMenuBar* bar = frame->GetMenuBar();
    ASSERT_EQ(bar->GetMenuCount(), 2u);
    EXPECT_EQ(bar->GetMenuLabel(0), "&File");
    EXPECT_EQ(bar->GetMenuLabel(1), "&Help");

    const std::vector<wxString> file = {"1001 Create &Printer Profile...",
                                        "1002 Create &Monitor Profile...",
                                        "1003 Create &Device Link Profile...",
                                        "-",
                                        "1005 &Inspect Profile...",
                                        "1006 &Edit Profile...",
                                        "1004 &Verify Color...",
                                        "-",
                                        "1007 E&xit"};
    EXPECT_EQ(Describe(bar->GetMenu(0)), file);

    const std::vector<wxString> help = {"1015 Veltrona &Help\tF1",
                                        "1016 User Guide",
                                        "1017 User Forum",
                                        "1107 How-To",
                                        "-",
                                        "1019 &About Veltrona",
                                        "1023 About &Modules",
                                        "  1025 Quenta Print Studio",
                                        "  1026 Zel Display Studio",
                                        "  1027 Quenta Link Studio",
                                        "  1028 Quenta Inspect Studio",
                                        "  1029 Quenta Edit Studio",
                                        "  1030 Zel Verify Studio",
                                        "-",
                                        "1020 Check for Updates..."};
    EXPECT_EQ(Describe(bar->GetMenu(1)), help);
    frame->Destroy();
}

TEST(FrameTest, FixedSizeAroundTheView)
{
    auto* frame = new Veltro3AppFrame("Veltrona", wxDefaultPosition, wxDefaultSize);
    frame->Show();
    EXPECT_EQ(frame->GetStandardView()->GetSize(), wxSize(564, 344));
    EXPECT_EQ(frame->GetMinSize(), frame->GetSize());
    EXPECT_EQ(frame->GetMaxSize(), frame->GetSize());
    EXPECT_FALSE(frame->HasFlag(wxRESIZE_BORDER));
    EXPECT_FALSE(frame->HasFlag(wxMAXIMIZE_BOX));
    EXPECT_TRUE(frame->HasFlag(wxMINIMIZE_BOX));

    frame->SetSize(900, 700);
    EXPECT_EQ(frame->GetMinSize(), frame->GetSize());
    frame->Destroy();
}

TEST(FrameTest, ExitClosesAtOnceWithoutAsking)
{
    DialogRecorder dialogs;
    auto* frame = new Veltro3AppFrame("Veltrona", wxDefaultPosition, wxDefaultSize);
    frame->Show();
    bool destroyed = false;
    frame->Bind(wxEVT_DESTROY, [&](wxWindowDestroyEvent& event) {
        destroyed = destroyed || event.GetEventObject() == frame;
        event.Skip();
    });

    wxCommandEvent exit(wxEVT_MENU, 1007);
    frame->ProcessWindowEvent(exit);
    EXPECT_FALSE(frame->IsShown());
    EXPECT_TRUE(WaitFor([&] { return destroyed; }));
    EXPECT_TRUE(dialogs.Dialogs().empty());
}

} // namespace
