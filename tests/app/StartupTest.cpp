// Start-up and shutdown of the real launcher, run as its own process.
#include "controls/TextBitmap.h"
#include "frame/ModuleCatalog.h"
#include "frame/Veltro3AppFrame.h"
#include "frame/Veltro3MainAppStandardView.h"
#include "resources/ImageSets.h"
#include "support/DesktopTools.h"
#include "support/GuiWait.h"
#include "support/ProbeRun.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"
#include "support/XvfbServer.h"

#include <gtest/gtest.h>
#include <wx/image.h>

#include <cstdlib>
#include <filesystem>
#include <memory>
#include <set>
#include <tuple>

namespace {

// The view's buttons: where they lie, their modules and icons. The first four labels have no
// descenders; the second button lies under the pointer, at the screen's centre.
const struct
{
    wxPoint at;
    int module;
    const char* icon;
} kButtons[] = {
    {{228, 68}, 1001, "PrinterModule"},     {{228, 155}, 1002, "MonitorModule"},
    {{228, 237}, 1003, "LinkStudioModule"}, {{405, 155}, 1006, "EditModule"},
    {{405, 68}, 1005, "InspectorModule"},   {{405, 237}, 1004, "VerifierModule"},
};

int Distance(const wxImage& a, int ax, int ay, const wxImage& b, int bx, int by)
{
    int sum = 0;
    for (int c = 0; c < 3; ++c)
        sum += std::abs(a.GetData()[3 * (ay * a.GetWidth() + ax) + c] -
                        b.GetData()[3 * (by * b.GetWidth() + bx) + c]);
    return sum;
}

// At 200% `shot`, from `at` on, must lie far closer to `scaled` than to `normal` doubled,
// over the pixels opaque in both.
void ExpectScaled(const wxImage& shot, const wxPoint& at, const wxImage& normal,
                  const wxImage& scaled, const std::string& what)
{
    long toDoubled = 0, toScaled = 0;
    for (int y = 0; y < scaled.GetHeight(); ++y)
        for (int x = 0; x < scaled.GetWidth(); ++x)
            if (scaled.GetAlpha(x, y) == 255 && normal.GetAlpha(x / 2, y / 2) == 255) {
                toScaled += Distance(shot, 2 * at.x + x, 2 * at.y + y, scaled, x, y);
                toDoubled += Distance(shot, 2 * at.x + x, 2 * at.y + y, normal, x / 2, y / 2);
            }
    EXPECT_LT(toScaled * 4, toDoubled) << what << " is a doubled 1x one";
}

// A button's normal look over the view's colour, drawn at `scale`: its icon at (6, 2),
// its label 16 pixels right of the icon, vertically centred.
wxImage ButtonAt(wxWindow* view, int index, double scale)
{
    const auto& button = kButtons[index];
    wxImage colour(152 * scale, 58 * scale);
    colour.SetRGB(wxRect(colour.GetSize()), 224, 223, 227);
    const wxBitmap icon = LoadPicture(wxString("Veltro2AppFrame::") + button.icon, scale);
    const wxBitmap label =
        DrawTextToBitmap(wxSize(152, 58), wxPoint(48 + 16, 29), view->GetFont(),
                         FindModule(button.module)->buttonLabel, view->GetForegroundColour(),
                         wxALIGN_CENTER_VERTICAL, 0, scale);
    const wxBitmap back(colour, wxBITMAP_SCREEN_DEPTH, scale);
    return CompositeBitmap(CompositeBitmap(back, icon, wxPoint(6, 2)), label).ConvertToImage();
}

// Rows and columns of ink (pixels far from the button's colour) in a label.
wxRect LabelInk(const wxImage& view, const wxPoint& button, double scale)
{
    wxImage colour(1, 1);
    colour.SetRGB(0, 0, 224, 223, 227);
    wxRect ink;
    for (int y = button.y * scale; y < (button.y + 58) * scale; ++y)
        for (int x = (button.x + 64) * scale; x < (button.x + 152) * scale; ++x)
            if (Distance(view, x, y, colour, 0, 0) > 150)
                ink = ink.IsEmpty() ? wxRect(x, y, 1, 1) : ink.Union(wxRect(x, y, 1, 1));
    return ink;
}

// The screen check counts the monitor's pixels against what the windows need at the
// desktop's scale; the view and the splash are drawn at that scale; large text fits.
TEST(StartupTest, ScreensOfEveryScaleAndTextSize)
{
    EnsureLauncherImages();
    StandinDir install({});
    const struct
    {
        int width, height;
        const char *scale, *textScale, *refusal;
    } cases[] = {
        {1280, 720, "1", "1", "1024 x 768"}, {1024, 768, "2", "1", "1128 x 908"},
        {1024, 768, "1", "1", nullptr},      {2560, 1440, "2", "1", nullptr},
        {1024, 768, "1", "1.5", nullptr},
    };
    std::vector<std::unique_ptr<XvfbServer>> servers;
    std::vector<std::unique_ptr<ProbeRun>> runs;
    for (const auto& c : cases) {
        servers.push_back(std::make_unique<XvfbServer>(c.width, c.height));
        ASSERT_FALSE(servers.back()->Display().empty());
        runs.push_back(std::make_unique<ProbeRun>(install.Path(), Args{},
                                                  EnvList{{"DISPLAY", servers.back()->Display()},
                                                          {"LC_ALL", "C.UTF-8"},
                                                          {"GDK_SCALE", c.scale},
                                                          {"GDK_DPI_SCALE", c.textScale}}));
    }
    // The shown window's client area once painted and settled.
    auto shot = [&](size_t i, const std::string& title, const auto& painted) {
        wxImage image;
        EXPECT_TRUE(WaitFor([&] {
            for (const ProbeEvent& e : runs[i]->Events("placed"))
                if (e.fields[0] == title) {
                    const wxImage now =
                        ScreenPixels(wxRect(std::stoi(e.fields[1]), std::stoi(e.fields[2]),
                                            std::stoi(e.fields[3]), std::stoi(e.fields[4])),
                                     servers[i]->Display());
                    const bool same = image.IsOk() && SamePixels(now, image, 0);
                    image = now;
                    return same && painted(now);
                }
            return false;
        })) << title;
        return image;
    };
    // The start-up splash at 200%, once its text, drawn last, shows.
    const wxImage splash = shot(3, "", [](const wxImage& image) {
        for (int x = 0; x < image.GetWidth() && image.GetSize() == wxSize(890, 850); ++x)
            if (image.GetRed(x, 2 * 346) > 150)
                return true;
        return false;
    });
    wxImage views[5];
    for (size_t i = 0; i < runs.size(); ++i) {
        SCOPED_TRACE(i);
        if (cases[i].refusal) {
            EXPECT_GT(runs[i]->ExitCode(20000), 0);
            const auto events = runs[i]->Events();
            EXPECT_EQ(events.size(), 1u) << "one message, no window";
            EXPECT_EQ(events.at(0).fields[0], std::string("Please set your monitor to a supported "
                                                          "resolution.\nMinimum required: ") +
                                                  cases[i].refusal);
            continue;
        }
        ASSERT_TRUE(runs[i]->WaitForShown());
        EXPECT_TRUE(runs[i]->Events("dialog").empty());
        const double scale = std::stod(cases[i].scale);
        views[i] = shot(i, "Veltrona", [&](const wxImage& image) {
            return image.GetSize() == wxSize(564, 344) * scale &&
                   !LabelInk(image, kButtons[5].at, scale).IsEmpty();
        });
        // Every label at one size: the same baseline, and each within its button.
        const wxRect first = LabelInk(views[i], kButtons[0].at, scale);
        for (int b = 0; b < 6; ++b) {
            const wxPoint& at = kButtons[b].at;
            const wxRect ink = LabelInk(views[i], at, scale);
            EXPECT_LE(ink.GetRight(), (at.x + 152 - 2) * scale) << kButtons[b].icon;
            EXPECT_TRUE(b >= 4 || ink.GetBottom() - at.y * scale == first.GetBottom() - 68 * scale)
                << kButtons[b].icon;
        }
    }

    // The titles stay above their columns however large the text.
    const wxRect pastColumn(557, 15, 7, 35);
    EXPECT_TRUE(SamePixels(
        views[4].GetSubImage(pastColumn),
        LoadPicture("Veltro2AppFrame::LauncherBG", 1).ConvertToImage().GetSubImage(pastColumn), 50))
        << "\"Evaluate Profile\" runs past its column";

    // At 200% the pictures are their 2x renderings, the labels drawn at that resolution.
    auto picture = [](const char* name, double scale, const wxRect& area) {
        return LoadPicture(wxString("Veltro2AppFrame::") + name, scale)
            .ConvertToImage()
            .GetSubImage(wxRect(area.GetPosition() * scale, area.GetSize() * scale));
    };
    for (const auto& [shown, name, area] :
         {std::make_tuple(views[3], "LauncherBG", wxRect(10, 10, 190, 290)),
          std::make_tuple(splash, "SplashMainApp", wxRect(0, 0, 445, 300))})
        ExpectScaled(shown, area.GetPosition(), picture(name, 1, area), picture(name, 2, area),
                     name);
    auto* frame = new Veltro3AppFrame("Veltrona", wxDefaultPosition, wxDefaultSize);
    for (int b : {0, 2, 3, 4, 5})
        ExpectScaled(views[3], kButtons[b].at, ButtonAt(frame->GetStandardView(), b, 1),
                     ButtonAt(frame->GetStandardView(), b, 2), kButtons[b].icon);
    frame->Destroy();
}

// Found through PATH, through a link elsewhere, or by its path: the launcher
// works from its own folder, opens the caller's file, and its close box ends it.
TEST(StartupTest, WorksFromItsOwnFolderAndOpensTheCallersFile)
{
    StandinDir installDir({"Quenta Inspect Studio.exe"}), profilesDir({});
    const std::string install = installDir.Path(), profiles = profilesDir.Path();
    std::filesystem::create_symlink(install + "/Veltrona.exe", profiles + "/veltrona");
    const struct
    {
        ProbeStart start;
        Args args;
        Args opened; // Inspect's arguments, if it opens
    } cases[] = {
        {{install + "/Veltrona.exe", "Veltrona.exe", profiles}, {"x.icc"}, {profiles + "/x.icc"}},
        {{profiles + "/veltrona", "", profiles},
         {"./a b/\"c\".icc", "second.icc"},
         {profiles + "/a b/\"c\".icc"}},
        {{"", "", profiles}, {"\xff\xfe.icc", "second.icc"}, {}},
    };

    std::vector<std::unique_ptr<ProbeRun>> runs;
    std::multiset<Args> expected;
    for (const auto& c : cases) {
        runs.push_back(
            std::make_unique<ProbeRun>(install, c.args,
                                       EnvList{{"VELTRONA_STANDIN_LOG", install + "/starts.log"},
                                               {"VELTRONA_STANDIN_EXIT", "1"},
                                               {"PATH", install + ":" + std::getenv("PATH")}},
                                       c.start));
        if (!c.opened.empty())
            expected.insert(c.opened);
    }
    for (auto& run : runs) {
        ASSERT_TRUE(run->WaitForShown());
        // The untitled start-up splash first, the frame no earlier than 2000 ms after it.
        const auto shown = run->Events("shown");
        ASSERT_EQ(shown.size(), 2u);
        EXPECT_EQ(shown[0].fields[0], "");
        EXPECT_GE(std::stol(shown[1].fields[1]) - std::stol(shown[0].fields[1]), 2000);
        CloseWindow(run->Window());
        EXPECT_EQ(run->ExitCode(), 0);
        EXPECT_TRUE(run->Events("dialog").empty());
    }

    std::multiset<Args> opened;
    for (const StandinRecord& record : SettledRecords(install + "/starts.log")) {
        EXPECT_EQ(record.exe, install + "/Quenta Inspect Studio.exe");
        EXPECT_EQ(record.cwd, install);
        opened.insert(record.args);
    }
    EXPECT_EQ(opened, expected);
}

} // namespace
