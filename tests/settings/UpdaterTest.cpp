// The updater: its schedule and the "Silent" mark in the settings shared with
// it, the start from the Help menu, and the clean-up of its temporary files at
// start-up. The updater is the stand-in, which records the "Silent" it finds.
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
#include <sstream>
#include <sys/stat.h>

namespace fs = std::filesystem;

namespace {

const std::string kUpdater = "Quenta Updater.exe";
const std::string kSettings = "/Zelgrave/Zel Updater.conf";

std::string Day(int offset)
{
    return std::string((wxDateTime::Today() + wxDateSpan::Days(offset)).FormatISODate().utf8_str());
}

void WriteFile(const std::string& path, const std::string& text)
{
    fs::create_directories(fs::path(path).parent_path());
    std::ofstream(path, std::ios::binary) << text;
}

std::optional<std::string> ReadFile(const std::string& path)
{
    std::ifstream in(path, std::ios::binary);
    if (!in)
        return std::nullopt;
    std::ostringstream text;
    text << in.rdbuf();
    return text.str();
}

struct ScheduleCase
{
    const char* name;
    std::optional<std::string> userFile; // contents of the user's settings file
    std::optional<std::string> systemFile;
    bool starts;
    std::optional<std::string> silentAtStart; // as the updater finds it
    std::optional<std::string> silentFromMenu;
    std::optional<std::string> userFileAfter = std::nullopt; // nullopt: as before
};

TEST(UpdaterTest, ScheduleAndSilentMark)
{
    const std::string invalidUtf8 = "Silent=0\nName=\xe9t\xe9\n";
    const std::vector<ScheduleCase> cases = {
        {"no settings", std::nullopt, std::nullopt, true, std::nullopt, std::nullopt},
        {"Never", "Next\\ Launch=Never\n", std::nullopt, false, std::nullopt, std::nullopt},
        {"lower-case never", "Next\\ Launch=never\n", std::nullopt, true, std::nullopt,
         std::nullopt},
        {"today", "Next\\ Launch=" + Day(0) + "\n", std::nullopt, true, std::nullopt, std::nullopt},
        {"tomorrow", "Next\\ Launch=" + Day(1) + "\n", std::nullopt, false, std::nullopt,
         std::nullopt},
        {"date with more after it", "Next\\ Launch=" + Day(1) + "x\n", std::nullopt, true,
         std::nullopt, std::nullopt},
        {"Silent 0 is marked", "Silent=0\n# kept\n[Other]\nkey=value\n", std::nullopt, true, "1",
         "0", "Silent=0\n# kept\n[Other]\nkey=value\n"},
        {"Silent only system-wide", std::nullopt, "Silent=0\n", true, "1", "0", "Silent=0\n"},
        {"Silent not a number", "Silent=abc\n", std::nullopt, true, "abc", "abc"},
        {"file not UTF-8 is left alone", invalidUtf8, std::nullopt, true, "0", "0"},
        {"tomorrow from the system file", std::nullopt, "Next\\ Launch=" + Day(1) + "\n", false,
         std::nullopt, std::nullopt},
    };

    for (const ScheduleCase& test : cases) {
        SCOPED_TRACE(test.name);
        StandinDir install({kUpdater});
        const std::string root = install.Path();
        const std::string log = root + "/starts.log";
        const std::string userFile = root + "/config" + kSettings;
        ScopedEnv env({{"XDG_CONFIG_HOME", root + "/config"},
                       {"XDG_CONFIG_DIRS", root + "/etc:/etc/xdg"},
                       {"VELTRONA_STANDIN_LOG", log},
                       {"VELTRONA_STANDIN_EXIT", "1"}});
        if (test.userFile)
            WriteFile(userFile, *test.userFile);
        if (test.systemFile)
            WriteFile(root + "/etc" + kSettings, *test.systemFile);
        const wxString oldDir = wxGetCwd();
        wxSetWorkingDirectory(root);

        CheckForUpdateAtLaunch();
        auto records = SettledRecords(log);
        ASSERT_EQ(records.size(), test.starts ? 1u : 0u);
        if (test.starts) {
            EXPECT_EQ(records[0].exe, root + "/" + kUpdater);
            EXPECT_TRUE(records[0].args.empty());
            EXPECT_EQ(records[0].silent, test.silentAtStart);
        }

        CheckForUpdatesNow();
        records = SettledRecords(log);
        wxSetWorkingDirectory(oldDir);
        ASSERT_EQ(records.size(), test.starts ? 2u : 1u);
        EXPECT_EQ(records.back().silent, test.silentFromMenu);

        // Only "Silent" ever changes; everything else in the file stays.
        EXPECT_EQ(ReadFile(userFile), test.userFileAfter ? test.userFileAfter : test.userFile);
        if (test.userFileAfter && !test.userFile) {
            struct stat info;
            ASSERT_EQ(stat((root + "/config/Zelgrave").c_str(), &info), 0);
            EXPECT_EQ(info.st_mode & 0777, 0700u);
        }
    }
}

TEST(UpdaterTest, StartUpRemovesLeftoversAndStartsADueUpdate)
{
    StandinDir install({kUpdater});
    StandinDir runtime({});
    chmod(runtime.Path().c_str(), 0700);
    const std::string tmp = install.Path() + "/tmp";
    fs::create_directories(tmp + "/ZELUPDATE_dir");
    WriteFile(tmp + "/ZELUPDATE_abc", "left over");
    WriteFile(tmp + "/other.txt", "not the updater's");
    WriteFile(tmp + "/xZELUPDATE_abc", "not the updater's");
    WriteFile(install.Path() + "/target", "linked to");
    fs::create_symlink(install.Path() + "/target", tmp + "/ZELUPDATE_link");
    WriteFile(install.Path() + "/config" + kSettings, "Silent=0\n");

    const std::string log = install.Path() + "/starts.log";
    ProbeRun launcher(install.Path(), {},
                      {{"XDG_RUNTIME_DIR", runtime.Path()},
                       {"XDG_CONFIG_HOME", install.Path() + "/config"},
                       {"TMPDIR", tmp},
                       {"VELTRONA_STANDIN_LOG", log},
                       {"VELTRONA_STANDIN_EXIT", "1"}});
    ASSERT_TRUE(launcher.WaitForShown());
    const auto records = WaitForRecords(log, 1);
    ASSERT_EQ(records.size(), 1u);
    EXPECT_EQ(records[0].silent, "1");

    EXPECT_FALSE(fs::exists(tmp + "/ZELUPDATE_abc"));
    EXPECT_TRUE(fs::is_directory(tmp + "/ZELUPDATE_dir"));
    EXPECT_TRUE(fs::is_symlink(tmp + "/ZELUPDATE_link"));
    EXPECT_TRUE(fs::exists(install.Path() + "/target"));
    EXPECT_TRUE(fs::exists(tmp + "/other.txt"));
    EXPECT_TRUE(fs::exists(tmp + "/xZELUPDATE_abc"));
}

} // namespace
