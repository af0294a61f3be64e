// One copy of the launcher per user: a second copy ends without a window, and
// a copy that was killed never keeps the next one from starting.
#include "support/ProbeRun.h"
#include "support/StandinDir.h"

#include <gtest/gtest.h>

#include <csignal>
#include <fstream>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>
#include <wx/utils.h>

namespace {

TEST(InstanceLockTest, OneCopyPerUserAndNoneAfterACrash)
{
    StandinDir install({});
    StandinDir runtime({});
    chmod(runtime.Path().c_str(), 0700);
    const EnvList env = {{"XDG_RUNTIME_DIR", runtime.Path()}};

    auto first = std::make_unique<ProbeRun>(install.Path(), std::vector<std::string>{}, env);
    ASSERT_TRUE(first->WaitForShown());

    ProbeRun second(install.Path(), {}, env);
    int status = 0;
    ASSERT_TRUE(second.WaitForExit(20000, status));
    EXPECT_TRUE(second.Events("shown").empty());
    EXPECT_TRUE(second.Events("dialog").empty());

    // Killed copies leave their lock file behind, with a process id that the
    // system may give to another process: here, to this test.
    first->Kill(SIGKILL);
    ASSERT_TRUE(first->WaitForExit(10000, status));
    const std::string lock =
        runtime.Path() + "/veltrona/Zelgrave.Veltrona." + std::string(wxGetUserId().utf8_str());
    ASSERT_TRUE(std::ifstream(lock).good()) << lock;
    std::ofstream(lock, std::ios::trunc) << getpid() << "\n";
    first.reset();

    ProbeRun third(install.Path(), {}, env);
    EXPECT_TRUE(third.WaitForShown());
}

} // namespace
