// One copy of the launcher per user: of copies started together exactly one
// runs, and a copy killed outright never keeps the next one from starting.
#include "support/GuiWait.h"
#include "support/ProbeRun.h"
#include "support/StandinDir.h"

#include <gtest/gtest.h>

#include <csignal>
#include <memory>

namespace {

TEST(InstanceLockTest, TenCopiesAtOnceGiveOneAndAKilledCopyBlocksNone)
{
    StandinDir install({});
    const EnvList env = {{"XDG_RUNTIME_DIR", install.Path()}};
    for (int round = 0; round < 6; ++round) {
        SCOPED_TRACE(round);
        std::vector<std::unique_ptr<ProbeRun>> running, ended;
        for (int i = 0; i < 10; ++i)
            running.push_back(
                std::make_unique<ProbeRun>(install.Path(), std::vector<std::string>{}, env));
        // Nine end without a window; the one left runs.
        ASSERT_TRUE(WaitFor(
            [&] {
                for (auto copy = running.begin(); copy != running.end();) {
                    int status = 0;
                    if ((*copy)->WaitForExit(0, status)) {
                        ended.push_back(std::move(*copy));
                        copy = running.erase(copy);
                    } else {
                        ++copy;
                    }
                }
                return running.size() <= 1;
            },
            30000));
        ASSERT_EQ(running.size(), 1u);
        for (const auto& copy : ended)
            EXPECT_TRUE(copy->Events("shown").empty());
        // The last round's copy shows its frame; the others are killed outright.
        if (round == 5) {
            EXPECT_TRUE(running[0]->WaitForShown());
        }
        running[0]->Kill(SIGKILL);
        int status = 0;
        ASSERT_TRUE(running[0]->WaitForExit(10000, status));
    }
}

} // namespace
