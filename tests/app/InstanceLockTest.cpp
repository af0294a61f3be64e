// One copy of the launcher per user: of copies started together exactly one
// runs, and a copy killed outright never keeps the next one from starting.
#include "support/GuiWait.h"
#include "support/ProbeRun.h"
#include "support/StandinDir.h"

#include <gtest/gtest.h>

#include <csignal>
#include <memory>
#include <sys/stat.h>

namespace {

TEST(InstanceLockTest, TenCopiesAtOnceGiveOneAndAKilledCopyBlocksNone)
{
    StandinDir install({});
    StandinDir runtime({});
    chmod(runtime.Path().c_str(), 0700);
    const EnvList env = {{"XDG_RUNTIME_DIR", runtime.Path()}};

    const int rounds = 6;
    for (int round = 0; round < rounds; ++round) {
        std::vector<std::unique_ptr<ProbeRun>> copies;
        for (int i = 0; i < 10; ++i)
            copies.push_back(
                std::make_unique<ProbeRun>(install.Path(), std::vector<std::string>{}, env));
        // Nine end without a window; the one left runs.
        std::vector<bool> ended(copies.size(), false);
        size_t endedCount = 0;
        ASSERT_TRUE(WaitFor(
            [&] {
                for (size_t i = 0; i < copies.size(); ++i) {
                    int status = 0;
                    if (!ended[i] && copies[i]->WaitForExit(0, status)) {
                        ended[i] = true;
                        ++endedCount;
                    }
                }
                return endedCount >= copies.size() - 1;
            },
            30000))
            << "round " << round << ": " << endedCount << " ended";
        ProbeRun* running = nullptr;
        for (size_t i = 0; i < copies.size(); ++i) {
            if (ended[i])
                EXPECT_TRUE(copies[i]->Events("shown").empty()) << "round " << round;
            else
                running = copies[i].get();
        }
        ASSERT_NE(running, nullptr) << "round " << round;

        // The last round's copy shows its frame; the others are killed outright.
        if (round == rounds - 1) {
            EXPECT_TRUE(running->WaitForShown()) << "round " << round;
        }
        running->Kill(SIGKILL);
        int status = 0;
        ASSERT_TRUE(running->WaitForExit(10000, status));
    }
}

} // namespace
