// The updater's schedule and "Silent" mark (its stand-in records the "Silent" it
// finds), the start from the Help menu, the clean-up of its temporary files.
#include "settings/CProfileConfig.h"
#include "settings/UpdateCheck.h"
#include "support/ProbeRun.h"
#include "support/ScopedEnv.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gtest/gtest.h>
#include <wx/datetime.h>
#include <wx/filefn.h>

#include <filesystem>
#include <fstream>

namespace fs = std::filesystem;

namespace {

const std::string kUpdater = "Quenta Updater.exe";
const std::string kSettings = "/Zelgrave/Zel Updater.conf";

std::string NextLaunch(int days, const std::string& after = "")
{
    const wxDateTime day = wxDateTime::Today() + wxDateSpan::Days(days);
    return "Next\\ Launch=" + std::string(day.FormatISODate().utf8_str()) + after + "\n";
}

TEST(UpdaterTest, ScheduleAndSilentMark)
{
    using Value = std::optional<std::string>;
    const std::string kept = "Silent=0\n# kept\n[Other]\nkey=value\n";
    // Files given as "" are not there; userAfter "" means unchanged.
    const struct
    {
        std::string user, system;
        bool starts;
        Value atLaunch, fromMenu;
        std::string userAfter;
        bool readOnly = false, link = false;
    } cases[] = {
        {"", "", true, {}, {}, ""},
        {"Next\\ Launch=Never\n", "", false, {}, {}, ""},
        {NextLaunch(1), "", false, {}, {}, ""},
        {NextLaunch(1, "x"), "", true, {}, {}, ""},
        {NextLaunch(1, " 12:00"), "", false, {}, {}, ""},
        {NextLaunch(1, "T00:00:00"), "", false, {}, {}, ""},
        {NextLaunch(0, " 23:59"), "", true, {}, {}, ""},
        {"", NextLaunch(1), false, {}, {}, ""},
        {kept, "", true, "1", "0", kept},
        {"", "Silent=0\n", true, "1", "0", "Silent=0\n"},
        {"Silent=abc\n", "", true, "abc", "abc", ""},
        // Not UTF-8, read-only, a link: written only through the link.
        {"Silent=0\nName=\xe9t\xe9\n", "", false, {}, "0", ""},
        {"Silent=1\n", "", false, {}, "1", "", true},
        {"Silent=5\n", "", true, "1", "0", "Silent=0\n", false, true},
    };
    for (const auto& test : cases) {
        SCOPED_TRACE(test.user + "|" + test.system);
        StandinDir install({kUpdater});
        const std::string root = install.Path(), log = root + "/starts.log";
        const std::string user = root + "/config" + kSettings;
        ScopedEnv env({{"XDG_CONFIG_HOME", root + "/config"},
                       {"XDG_CONFIG_DIRS", root + "/etc"},
                       {"VELTRONA_STANDIN_LOG", log},
                       {"VELTRONA_STANDIN_EXIT", "1"}});
        if (test.link) {
            fs::create_directories(fs::path(user).parent_path());
            fs::create_symlink(install.Write("target", test.user), user);
        } else if (!test.user.empty()) {
            install.Write(user, test.user);
        }
        if (test.readOnly)
            fs::permissions(user, fs::perms(0444));
        if (!test.system.empty())
            install.Write("etc" + kSettings, test.system);
        wxSetWorkingDirectory(root);
        CheckForUpdateAtLaunch();
        const auto atLaunch = SettledRecords(log);
        CheckForUpdatesNow();
        const auto all = SettledRecords(log);
        // The launcher reads what the updater reads.
        const wxString silent = CProfileConfig("Zel Updater").ReadString("Silent", "none");

        ASSERT_EQ(atLaunch.size(), test.starts ? 1u : 0u);
        ASSERT_EQ(all.size(), atLaunch.size() + 1);
        EXPECT_EQ(all[0].exe, root + "/" + kUpdater);
        if (test.starts) {
            EXPECT_EQ(atLaunch[0].silent, test.atLaunch);
        }
        EXPECT_EQ(all.back().silent, test.fromMenu);
        EXPECT_EQ(silent.ToStdString(), test.fromMenu.value_or("none"));
        EXPECT_EQ(fs::is_symlink(user), test.link);
        std::ifstream after(user, std::ios::binary);
        EXPECT_EQ(std::string(std::istreambuf_iterator<char>(after), {}),
                  test.userAfter.empty() ? test.user : test.userAfter);
    }
}

TEST(UpdaterTest, StartUpRemovesLeftoversAndStartsADueUpdate)
{
    StandinDir install({kUpdater});
    const std::string root = install.Path(), tmp = root + "/tmp", log = root + "/starts.log";
    fs::create_directories(tmp + "/ZELUPDATE_dir");
    for (const char* name : {"/ZELUPDATE_abc", "/ZELUPDATE_open", "/other.txt", "/xZELUPDATE_abc"})
        install.Write("tmp" + std::string(name), "x");
    // Held open by this process, as by a running updater.
    const std::ifstream held(tmp + "/ZELUPDATE_open");
    fs::create_symlink(install.Write("target", "x"), tmp + "/ZELUPDATE_link");
    install.Write("config" + kSettings, "Silent=0\n");

    ProbeRun launcher(root, {},
                      {{"XDG_CONFIG_HOME", root + "/config"},
                       {"TMPDIR", tmp},
                       {"VELTRONA_STANDIN_LOG", log},
                       {"VELTRONA_STANDIN_EXIT", "1"}});
    ASSERT_TRUE(launcher.WaitForShown());
    const auto records = WaitForRecords(log, 1);
    ASSERT_EQ(records.size(), 1u);
    EXPECT_EQ(records[0].silent, "1");
    EXPECT_FALSE(fs::exists(tmp + "/ZELUPDATE_abc"));
    EXPECT_TRUE(fs::exists(tmp + "/ZELUPDATE_open"));
    EXPECT_TRUE(fs::is_directory(tmp + "/ZELUPDATE_dir"));
    EXPECT_TRUE(fs::is_symlink(tmp + "/ZELUPDATE_link") && fs::exists(root + "/target"));
    EXPECT_TRUE(fs::exists(tmp + "/other.txt") && fs::exists(tmp + "/xZELUPDATE_abc"));
}

} // namespace
