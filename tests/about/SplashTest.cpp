// The splash and About windows on the real display: their lines, where the text goes,
// when they close and how the About text scrolls.
#include "about/Splash.h"
#include "about/SplashScreen.h"
#include "platform/ScreenCapture.h"
#include "support/GuiWait.h"

#include <gtest/gtest.h>

#include <gdk/gdk.h>
#include <wx/translation.h>
#include <wx/uiaction.h>

#include <chrono>
#include <cstdio>
#include <fstream>

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

// Whether rows [from, to) of `now` are rows [from + shift, to + shift) of `before`.
bool ShiftedUp(const wxImage& before, const wxImage& now, int from, int to, int shift)
{
    const size_t row = size_t(now.GetWidth()) * 3;
    for (int y = from; y < to; ++y)
        if (!std::equal(now.GetData() + y * row, now.GetData() + (y + 1) * row,
                        before.GetData() + (y + shift) * row))
            return false;
    return true;
}

// Translations of the catalogue "Veltro" made by msgfmt from the given entries.
class Catalogue : public wxTranslationsLoader
{
public:
    explicit Catalogue(const std::vector<std::pair<std::string, std::string>>& entries)
    {
        const std::string po = testing::TempDir() + "extra.po", mo = po + ".mo";
        std::ofstream out(po);
        out << "msgid \"\"\nmsgstr \"Content-Type: text/plain; charset=UTF-8\\n\"\n";
        for (const auto& e : entries)
            out << "msgid \"" << e.first << "\"\nmsgstr \"" << e.second << "\"\n";
        out.close();
        EXPECT_EQ(std::system(("msgfmt -o '" + mo + "' '" + po + "'").c_str()), 0);
        std::ifstream in(mo, std::ios::binary);
        m_bytes.assign(std::istreambuf_iterator<char>(in), {});
        std::remove(po.c_str());
        std::remove(mo.c_str());
    }
    wxMsgCatalog* LoadCatalog(const wxString& domain, const wxString&) override
    {
        return wxMsgCatalog::CreateFromData(
            wxScopedCharBuffer::CreateNonOwned(m_bytes.data(), m_bytes.size()), domain);
    }
    wxArrayString GetAvailableTranslations(const wxString&) const override
    {
        return wxArrayString(1, "de");
    }

private:
    std::vector<char> m_bytes;
};

} // namespace

TEST(Splash, ExtraLegalLinesFollowTheCatalogue)
{
    int count = 0;
    const wxArrayString startup = SplashLines(true, count);
    EXPECT_EQ(count, 7);
    ASSERT_EQ(startup.size(), 7u);
    EXPECT_EQ(startup[0], "Version: 3.1.2.01");

    const struct
    {
        std::vector<std::pair<std::string, std::string>> entries;
        int windowLines;
    } cases[] = {
        {{}, 17},
        {{{"EXTRALEGAL_1", "Extra one"}}, 18},
        {{{"EXTRALEGAL_2", "Extra two"}}, 17},
        {{{"EXTRALEGAL_1", "Extra one"}, {"EXTRALEGAL_2", "Extra two"}}, 19},
    };
    for (const auto& c : cases) {
        auto* translations = new wxTranslations;
        translations->SetLanguage("de");
        translations->SetLoader(new Catalogue(c.entries));
        wxTranslations::Set(translations);
        ASSERT_TRUE(translations->AddCatalog("Veltro"));
        const wxArrayString lines = SplashLines(false, count);
        EXPECT_EQ(count, c.windowLines);
        EXPECT_EQ(int(lines.size()), 68 + c.windowLines);
        EXPECT_EQ(lines[16], "By using this program, you accept its terms.");
        if (c.windowLines > 17) {
            EXPECT_EQ(lines[17], "Extra one");
        }
        if (c.windowLines > 18) {
            EXPECT_EQ(lines[18], "Extra two");
        }
        EXPECT_EQ(lines[count], "");
        EXPECT_EQ(lines.Last(), "");
    }
    wxTranslations::Set(nullptr);
}

TEST(Splash, TextWindowStaysWithinTheMarginsLeftFirst)
{
    const struct
    {
        int centreX, centreY, textWidth;
        wxRect expected;
    } cases[] = {
        {192, 372, 200, {92, 313, 200, 119}},
        {400, 372, 100, {295, 313, 100, 119}}, // right margin
        {192, 372, 360, {48, 313, 360, 119}},  // wider than the picture minus margins
        {192, 50, 200, {92, 48, 200, 119}},    // top margin
    };
    for (const auto& c : cases)
        EXPECT_EQ(PlaceTextWindow(443, {c.textWidth, 900}, {c.centreX, c.centreY}, 119, 48),
                  c.expected)
            << c.centreX << "," << c.centreY << " " << c.textWidth;
}

TEST(Splash, LargeFontsDrawAtSevenPoints)
{
    wxFrame frame(nullptr, wxID_ANY, "fonts");
    EXPECT_EQ(SplashTextFont(&frame).GetPointSize(), 8);
    gdk_screen_set_resolution(gdk_screen_get_default(), 300);
    EXPECT_EQ(SplashTextFont(&frame).GetPointSize(), 7);
    gdk_screen_set_resolution(gdk_screen_get_default(), 96);
}

TEST(Splash, StartupSplashIgnoresInputAndClosesWhenItsTimerFires)
{
    const auto start = Clock::now();
    ShowSplash(true, 2000);
    ZelSplashScreen* splash = OpenSplash();
    ASSERT_NE(splash, nullptr);
    EXPECT_EQ(wxWindow::GetCapture(), nullptr)
        << "a pointer grab would take other programs' clicks";
    const wxRect area = splash->GetScreenRect();
    EXPECT_EQ(area.GetSize(), wxSize(445, 425));
    EXPECT_EQ(area.GetPosition(), wxPoint((1280 - 445) / 2, (1024 - 425) / 2));
    wxUIActionSimulator input;
    input.MouseMove(area.GetPosition() + wxPoint(100, 100));
    input.MouseClick();
    input.Char('a');
    input.MouseMove(5, 5);
    input.MouseClick();
    ASSERT_TRUE(WaitFor([] { return OpenSplash() == nullptr; }, 10000));
    EXPECT_GE(MsSince(start), 2000);
}

TEST(Splash, AboutBoxClosesAtTheFirstPressKeyOrActivation)
{
    auto* other = new wxFrame(nullptr, wxID_ANY, "Other launcher window", {10, 10}, {200, 150});
    other->Show();
    const char* actions[] = {"press on it", "press on another window", "key", "activation"};
    wxUIActionSimulator input;
    for (const std::string action : actions) {
        // The user opens the About box from the menu: the window manager sees input first.
        input.MouseMove(60, 80);
        input.MouseClick();
        ShowSplash(false, 3000);
        ZelSplashScreen* about = OpenSplash();
        ASSERT_NE(about, nullptr) << action;
        ASSERT_TRUE(WaitFor([&] { return about->IsActive(); })) << action;
        EXPECT_TRUE(about->HasCapture()) << action;
        if (action == "press on it" || action == "press on another window") {
            input.MouseMove(action == "press on it"
                                ? about->GetScreenRect().GetPosition() + wxPoint(200, 200)
                                : wxPoint(60, 80));
            input.MouseDown();
            input.MouseUp();
        } else if (action == "key") {
            input.Char('x');
        } else {
            other->Raise();
            other->SetFocus();
        }
        EXPECT_TRUE(WaitFor([] { return OpenSplash() == nullptr; }, 2500)) << action;
        EXPECT_EQ(wxWindow::GetCapture(), nullptr) << action;
    }
    other->Destroy();
}

// A plain picture (no alpha, so no blend) and four short lines: the text, about 50 pixels
// high, wraps in a 28-pixel window within a few seconds.
TEST(Splash, AboutTextStandsStillThenRisesOnePixelPerTickAndWrapsWithoutGap)
{
    wxImage blue(300, 200);
    blue.SetRGB(wxRect(0, 0, 300, 200), 0, 0, 255);
    const wxBitmap picture(blue);
    wxArrayString lines;
    for (const char* line : {"First line", "Second line", "Third line", "Fourth line"})
        lines.Add(line);
    const auto start = Clock::now();
    auto* about = new ZelAboutSplashScreen(-1, false, 3000, picture, lines, {150, 100}, 17, 20,
                                           *wxWHITE, true);
    const wxRect area = about->GetScreenRect();
    const int top = 100 - 28 / 2, height = 4 * 7;
    wxImage before;
    ASSERT_TRUE(WaitFor([&] {
        before = CaptureScreen(area);
        return before.GetBlue(2, 2) == 255 && before.GetRed(2, 2) == 0;
    }));
    for (int x = 0; x < area.width; ++x)
        for (int y = top + height - 10; y < top + height; ++y)
            ASSERT_EQ(before.GetBlue(x, y), 255) << "lowest rows show the picture";

    int changes = 0, wrapped = 0;
    long firstChange = -1;
    std::vector<int> shifts;
    while (changes < 60) {
        wxImage now;
        ASSERT_TRUE(WaitFor([&] {
            now = CaptureScreen(area);
            return !std::equal(now.GetData(), now.GetData() + area.width * area.height * 3,
                               before.GetData());
        })) << "the text stopped after "
            << changes << " moves";
        if (firstChange < 0)
            firstChange = MsSince(start);
        int shift = 1;
        while (shift < 4 && !ShiftedUp(before, now, top, top + height - 11, shift))
            ++shift;
        shifts.push_back(shift);
        wrapped += now.GetBlue(area.width / 2, top + height - 5) != 255 ||
                   now.GetRed(area.width / 2, top + height - 5) != 0;
        before = now;
        ++changes;
    }
    about->Close();
    EXPECT_GE(firstChange, 3000);
    std::sort(shifts.begin(), shifts.end());
    EXPECT_EQ(shifts[shifts.size() / 2], 1) << "mostly one row per tick";
    EXPECT_LT(shifts.back(), 4) << "every move is an upward shift of the same text";
    EXPECT_GT(wrapped, 0) << "past the end the first line follows at once";
}
