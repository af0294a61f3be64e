// The real launcher as a keyboard user, a screen reader and an input method see it.
#include "support/AccessibilityBus.h"
#include "support/DesktopTools.h"
#include "support/GuiWait.h"
#include "support/ProbeRun.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <atspi/atspi.h>
#include <gtest/gtest.h>
#include <wx/image.h>

#include <algorithm>
#include <cstdlib>
#include <memory>

namespace {

// In reading order, as the buttons are.
const std::vector<std::string> kModules = {
    "Quenta Print Studio.exe",   "Monitor/Zel Display Studio.exe", "Quenta Link Studio.exe",
    "Quenta Inspect Studio.exe", "Quenta Edit Studio.exe",         "ZelVerifyStudio.exe"};

struct Button
{
    std::string name;
    bool focused;
    AtspiAccessible* accessible; // never released: a few proxies for the test's life
};

void Walk(AtspiAccessible* node, std::vector<Button>& buttons)
{
    if (atspi_accessible_get_role(node, nullptr) == ATSPI_ROLE_PUSH_BUTTON) {
        gchar* name = atspi_accessible_get_name(node, nullptr);
        AtspiStateSet* states = atspi_accessible_get_state_set(node);
        buttons.push_back({name, atspi_state_set_contains(states, ATSPI_STATE_FOCUSED) != 0, node});
        g_free(name);
        g_object_unref(states);
    }
    for (int i = 0, n = atspi_accessible_get_child_count(node, nullptr); i < n; ++i)
        Walk(atspi_accessible_get_child_at_index(node, i, nullptr), buttons);
}

// The push buttons on the test's own accessibility bus, where only the launcher is.
std::vector<Button> Buttons()
{
    std::vector<Button> buttons;
    AtspiAccessible* desktop = atspi_get_desktop(0);
    atspi_accessible_clear_cache(desktop);
    Walk(desktop, buttons);
    return buttons;
}

TEST(KeyboardAndReaderTest, ButtonsAnswerScreenReadersAndKeys)
{
    auto bus = std::make_unique<AccessibilityBus>();
    ASSERT_EQ(bus->Failure(), "");
    atspi_init();
    StandinDir install(kModules);
    const std::string log = install.Path() + "/starts.log";
    setenv("VELTRONA_STANDIN_LOG", log.c_str(), 1);
    setenv("VELTRONA_STANDIN_EXIT", "1", 1);
    size_t started = 0;
    auto expectStarted = [&](size_t module) {
        const auto records = WaitForRecords(log, ++started);
        ASSERT_EQ(records.size(), started) << kModules[module];
        EXPECT_EQ(records.back().exe, install.Path() + "/" + kModules[module]);
    };

    const std::pair<const char*, std::vector<std::string>> languages[] = {
        {"en_US.UTF-8", {"Printer", "Monitor", "Device Link", "Inspect", "Edit", "Verify", "Help"}},
        {"de_DE.UTF-8",
         {"Drucker", "Monitor", "Device Link", "Untersuchen", "Bearbeiten", "Verifizieren",
          "Hilfe"}}};
    for (const auto& [lang, names] : languages) {
        ProbeRun run(install.Path(), {}, {{"LANG", lang}});
        ASSERT_TRUE(run.WaitForShown()) << lang;
        std::vector<Button> buttons;
        EXPECT_TRUE(WaitFor([&] { return (buttons = Buttons()).size() == names.size(); }))
            << lang << ": the launcher's buttons on the accessibility bus";
        std::vector<std::string> found;
        AtspiAction* action = nullptr;
        for (const Button& b : buttons) {
            found.push_back(b.name);
            if (b.name == names[3])
                action = atspi_accessible_get_action_iface(b.accessible);
        }
        ASSERT_TRUE(std::is_permutation(found.begin(), found.end(), names.begin(), names.end()))
            << lang << ": " << ::testing::PrintToString(found);

        // A screen reader's click on Inspect starts the module.
        ASSERT_TRUE(action);
        gchar* actionName = atspi_action_get_action_name(action, 0, nullptr);
        EXPECT_STREQ(actionName, "click");
        g_free(actionName);
        EXPECT_TRUE(atspi_action_do_action(action, 0, nullptr));
        expectStarted(3);

        // Tab walks the buttons in reading order, round and round; Space presses Printer.
        const unsigned long window = run.Window();
        ASSERT_NE(window, 0u) << lang << ": the launcher's window";
        std::string focused;
        auto tab = [&] {
            const std::string before = focused;
            TypeKeys(window, "Tab");
            const bool moved = WaitFor([&] {
                for (const Button& b : Buttons())
                    if (b.focused && b.name != before)
                        return !(focused = b.name).empty();
                return false;
            });
            EXPECT_TRUE(moved) << lang << ": focus on a button after " << before;
            return focused;
        };
        for (size_t i = 0; i <= names.size() && focused != names[0]; ++i)
            tab();
        std::vector<std::string> order = {focused}, round = names;
        while (order.size() <= names.size())
            order.push_back(tab());
        round.push_back(names[0]);
        EXPECT_EQ(order, round) << lang;
        TypeKeys(window, "space");
        expectStarted(0);
        TypeKeys(window, "Tab Return");
        expectStarted(1);
    }
    // The bus's daemons are children of the test, which SettledRecords waits for too.
    bus.reset();
    EXPECT_EQ(SettledRecords(log).size(), started);
}

// The view (the client area below the menu bar) once settled and more than one colour.
wxImage SettledView(unsigned long window)
{
    const wxRect client = WindowRect(window);
    const wxRect view(client.x, client.GetBottom() - 343, 564, 344);
    wxImage last;
    int same = 0;
    WaitFor([&] {
        const wxImage now = ScreenPixels(view);
        same = last.IsOk() && SamePixels(now, last, 0) ? same + 1 : 0;
        last = now;
        const unsigned char* p = now.GetData();
        return same >= 5 && std::any_of(p, p + 3L * now.GetWidth() * now.GetHeight(),
                                        [p](unsigned char c) { return c != p[0]; });
    });
    return last;
}

TEST(KeyboardAndReaderTest, ViewPaintsUnderEveryInputMethod)
{
    StandinDir install(kModules);
    // GTK's X input method needs no server: Xlib opens its local one.
    const wxRect picture(0, 2, 200, 290); // the same in every language
    wxImage english, simple;
    std::system("xdotool mousemove 0 0");
    for (const char* lang : {"en_US.UTF-8", "ja_JP.UTF-8", "zh_CN.UTF-8"})
        for (const std::string inputMethod : {"simple", "xim"}) {
            ProbeRun run(install.Path(), {}, {{"LANG", lang}, {"GTK_IM_MODULE", inputMethod}});
            ASSERT_TRUE(run.WaitForShown()) << lang;
            const unsigned long window = run.Window();
            TypeKeys(window, "Tab");
            const wxImage view = SettledView(window);
            if (!english.IsOk())
                english = view;
            EXPECT_TRUE(SamePixels(view.GetSubImage(picture), english.GetSubImage(picture)))
                << lang << " " << inputMethod;
            if (inputMethod == "simple")
                simple = view;
            else
                EXPECT_TRUE(SamePixels(view, simple)) << lang << " " << inputMethod;
        }
}

} // namespace
