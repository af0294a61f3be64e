// The module stand-in's start record must round-trip whatever the launcher
// hands it: the launch tests read the arguments back from it.
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gtest/gtest.h>
#include <wx/utils.h>

TEST(StandinTest, RecordRoundTripsAwkwardArguments)
{
    StandinDir install({"Monitor/Zel Display Studio.exe"}), workDir({});
    const std::string exe = install.Path() + "/Monitor/Zel Display Studio.exe";
    const char* argv[] = {
        exe.c_str(),   "two words",         "",           "tab\there", "line\nbreak",
        "back\\slash", "\\n not a newline", "trailing\\", "ünïcode €", nullptr};
    wxExecuteEnv env{workDir.Path(), wxEnvVariableHashMap()};
    wxGetEnvMap(&env.env);
    env.env["VELTRONA_STANDIN_LOG"] = workDir.Path() + "/starts.log";
    env.env["VELTRONA_STANDIN_EXIT"] = "1";
    const long pid = wxExecute(argv, wxEXEC_ASYNC, nullptr, &env);
    ASSERT_GT(pid, 0);
    const auto records = SettledRecords(workDir.Path() + "/starts.log");
    ASSERT_EQ(records.size(), 1u);
    EXPECT_EQ(records[0].exe, exe);
    EXPECT_EQ(records[0].pid, pid);
    EXPECT_EQ(records[0].cwd, workDir.Path());
    EXPECT_EQ(records[0].args, std::vector<std::string>(argv + 1, std::end(argv) - 1));
}
