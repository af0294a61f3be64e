// The updater's schedule from the registry values the updater itself keeps:
// HKCU\Software\Zelgrave\Zel Updater, "Next Launch" and "Silent" (its stand-in records
// the "Silent" it finds there, and the test reads back what the launcher wrote).
#include "settings/UpdateCheck.h"
#include "support/ScopedEnv.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gtest/gtest.h>
#include <wx/datetime.h>
#include <wx/filefn.h>
#include <wx/msw/registry.h>

#include <optional>

namespace {

const wxString kKey = "Software\\Zelgrave\\Zel Updater";

wxString Day(int days, const wxString& after = "")
{
    return (wxDateTime::Today() + wxDateSpan::Days(days)).FormatISODate() + after;
}

TEST(UpdaterRegistryTest, NextLaunchDecidesTheStartAndSilentMarksHowItStarted)
{
    using Value = std::optional<std::string>;
    const struct
    {
        bool key;                   // the updater's key exists
        Value next;                 // "Next Launch", a string
        std::optional<long> silent; // "Silent", a DWORD
        bool starts;
        Value atLaunch, fromMenu; // what the stand-in found
    } cases[] = {
        {false, {}, {}, true, {}, {}},
        {true, {}, {}, true, {}, {}},
        {true, {}, 0, true, "1", "0"},
        {true, "Never", 1, false, {}, "0"},
        {true, Day(1).utf8_string(), {}, false, {}, {}},
        {true, Day(1, " 12:00").utf8_string(), 0, false, {}, "0"},
        {true, Day(-1).utf8_string(), 0, true, "1", "0"},
        {true, Day(0, "T00:00:00").utf8_string(), {}, true, {}, {}},
        {true, "someday", {}, true, {}, {}},
    };
    for (const auto& test : cases) {
        SCOPED_TRACE(test.next.value_or("-") + " " + std::to_string(test.silent.value_or(-1)));
        wxRegKey key(wxRegKey::HKCU, kKey);
        if (key.Exists()) {
            ASSERT_TRUE(key.DeleteSelf());
        }
        if (test.key) {
            ASSERT_TRUE(key.Create());
        }
        if (test.next)
            key.SetValue("Next Launch", wxString::FromUTF8(*test.next));
        if (test.silent)
            key.SetValue("Silent", *test.silent);

        StandinDir install({"Quenta Updater.exe"});
        const std::string log = install.Path() + "\\starts.log";
        const ScopedEnv env({{"VELTRONA_STANDIN_LOG", log}, {"VELTRONA_STANDIN_EXIT", "1"}});
        wxSetWorkingDirectory(install.Path());
        CheckForUpdateAtLaunch();
        const auto atLaunch = SettledRecords(log);
        CheckForUpdatesNow();
        const auto all = SettledRecords(log);

        ASSERT_EQ(atLaunch.size(), test.starts ? 1u : 0u);
        ASSERT_EQ(all.size(), atLaunch.size() + 1);
        EXPECT_EQ(all.back().exe, install.Path() + "\\Quenta Updater.exe");
        if (test.starts) {
            EXPECT_EQ(atLaunch[0].silent, test.atLaunch);
        }
        EXPECT_EQ(all.back().silent, test.fromMenu);
        long silent = -1;
        EXPECT_EQ(key.HasValue("Silent") && key.QueryValue("Silent", &silent),
                  test.silent.has_value());
        EXPECT_EQ(silent, test.silent ? 0 : -1) << "the menu's start marks it 0";
        EXPECT_EQ(key.HasValue("Next Launch"), test.next.has_value()) << "the launcher never plans";
    }
    wxRegKey(wxRegKey::HKCU, kKey).DeleteSelf();
}

} // namespace
