// The module stand-in: its start record must round-trip whatever the launcher
// hands it, and the Verify window must carry the class and title looked for.
#include "support/GuiWait.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <fstream>
#include <gtest/gtest.h>
#include <wx/utils.h>

// Starts argv[0], a link to the stand-in, in `dir`; it logs its start to
// dir/starts.log and writes its window's id to dir/ready.
static long Start(const char* const* argv, const wxString& dir)
{
    wxExecuteEnv env{dir, wxEnvVariableHashMap()};
    wxGetEnvMap(&env.env);
    env.env["VELTRONA_STANDIN_LOG"] = dir + "/starts.log";
    env.env["VELTRONA_STANDIN_READY"] = dir + "/ready";
    env.env["VELTRONA_STANDIN_EXIT"] = "0";
    return wxExecute(argv, wxEXEC_ASYNC, nullptr, &env);
}

TEST(StandinTest, RecordRoundTripsAwkwardArguments)
{
    StandinDir install({"Monitor/Zel Display Studio.exe"}), workDir({});
    const std::string exe = install.Path() + "/Monitor/Zel Display Studio.exe";
    const char* argv[] = {exe.c_str(),   "two words",   "",
                          "\"quoted\"",  "it's",        "tab\there",
                          "line\nbreak", "back\\slash", "\\n not a newline",
                          "trailing\\",  "\\t\t\\\n",   " ",
                          "ünïcode €",   nullptr};
    const long pid = Start(argv, workDir.Path());
    ASSERT_GT(pid, 0);
    const auto records = WaitForRecords(workDir.Path() + "/starts.log", 1);
    wxKill(pid, wxSIGKILL);
    ASSERT_EQ(records.size(), 1u);
    EXPECT_EQ(records[0].exe, exe);
    EXPECT_EQ(records[0].pid, pid);
    EXPECT_EQ(records[0].cwd, workDir.Path());
    EXPECT_EQ(records[0].args, std::vector<std::string>(argv + 1, std::end(argv) - 1));
}

TEST(StandinTest, VerifyWindowHasTheModulesClassAndTitle)
{
    StandinDir install({"ZelVerifyStudio.exe"});
    const std::string exe = install.Path() + "/ZelVerifyStudio.exe";
    const char* argv[] = {exe.c_str(), nullptr};
    const long pid = Start(argv, install.Path());
    ASSERT_GT(pid, 0);
    unsigned long window = 0;
    WaitFor([&] { return bool(std::ifstream(install.Path() + "/ready") >> window); });
    wxArrayString props; // as the launcher reads them: class, then the UTF-8 title
    wxExecute(wxString::Format("xprop -id %lu WM_CLASS _NET_WM_NAME", window), props, wxEXEC_SYNC);
    wxKill(pid, wxSIGKILL);
    ASSERT_EQ(props.size(), 2u);
    EXPECT_TRUE(props[0].EndsWith(", \"TFrm_Main\"")) << props[0];
    EXPECT_EQ(props[1].utf8_string(), "_NET_WM_NAME(UTF8_STRING) = \"Zel Verify Studio\"");
}
