// One copy of the launcher per user, also without XDG_RUNTIME_DIR.
#include "support/GuiWait.h"
#include "support/ProbeRun.h"
#include "support/StandinDir.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <memory>
#include <optional>
#include <sched.h>
#include <sstream>
#include <sys/mount.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

// Whether the topmost mount at `point` is shared, i.e. mounts made on it reach other
// namespaces; none when this process's root shows no mount there (a chroot that is no
// mount point itself shows no "/").
std::optional<bool> SharedMountAt(const std::string& point)
{
    std::ifstream info("/proc/self/mountinfo");
    std::optional<bool> shared;
    for (std::string line; std::getline(info, line);) {
        std::istringstream fields(line);
        std::string id, parent, device, root, mountPoint, options, tag;
        fields >> id >> parent >> device >> root >> mountPoint >> options;
        if (mountPoint != point)
            continue;
        shared = false;
        while (fields >> tag && tag != "-")
            shared = *shared || tag.rfind("shared:", 0) == 0;
    }
    return shared;
}

TEST(InstanceLockTest, TenCopiesAtOnceGiveOneAndAKilledCopyBlocksNone)
{
    StandinDir install({});
    const EnvList env = {{"XDG_RUNTIME_DIR", install.Path()}};
    for (int round = 0; round < 6; ++round) {
        SCOPED_TRACE(round);
        std::vector<std::unique_ptr<ProbeRun>> copies;
        for (int i = 0; i < 10; ++i)
            copies.push_back(std::make_unique<ProbeRun>(install.Path(), Args{}, env));
        // Nine end without a window; the one left runs.
        const auto ended = [](const auto& copy) { return copy->WaitForExit(0); };
        ASSERT_TRUE(WaitFor([&] { return std::count_if(copies.begin(), copies.end(), ended) >= 9; },
                            30000));
        const auto running = std::find_if_not(copies.begin(), copies.end(), ended);
        ASSERT_NE(running, copies.end());
        for (const auto& copy : copies)
            EXPECT_TRUE(copy == *running || copy->Events("shown").empty());
        // The last round's copy shows its frame; the others are killed outright.
        EXPECT_TRUE(round < 5 || (*running)->WaitForShown());
        (*running)->Kill(SIGKILL);
        ASSERT_TRUE((*running)->WaitForExit());
    }
}

TEST(InstanceLockTest, WithoutARuntimeDirATakenTmpFolderStillGivesOneCopy)
{
    // The taken folder is bound over /tmp/veltrona-<uid> in a mount namespace of this
    // test's own, so that it troubles nobody else; /tmp itself may hold the build.
    if (unshare(CLONE_NEWNS) != 0)
        GTEST_SKIP() << "needs root";
    // The mount that holds /tmp is made private, so that the bind does not reach the
    // namespace outside. In a chroot that mount may lie outside the root, out of reach:
    // /tmp then becomes a mount of its own, bound onto itself, unless that bind itself
    // already reached outside.
    std::string holder = SharedMountAt("/tmp") ? "/tmp" : "/";
    if (!SharedMountAt(holder)) {
        ASSERT_EQ(mount("/tmp", "/tmp", nullptr, MS_BIND, nullptr), 0) << std::strerror(errno);
        const std::optional<bool> shared = SharedMountAt("/tmp");
        ASSERT_TRUE(shared) << "/proc/self/mountinfo does not show the bind onto /tmp";
        if (*shared) {
            umount("/tmp");
            GTEST_SKIP() << "/tmp lies in a mount shared with namespaces outside this root, "
                            "which cannot be made private from inside it";
        }
        holder = "/tmp";
    }
    ASSERT_EQ(mount(nullptr, holder.c_str(), nullptr, MS_REC | MS_PRIVATE, nullptr), 0)
        << holder << ": " << std::strerror(errno);
    StandinDir install({});
    const EnvList env = {{"XDG_RUNTIME_DIR", ""}, {"XDG_CACHE_HOME", install.Path() + "/cache"}};
    const std::string path = "/tmp/veltrona-" + std::to_string(getuid());
    const std::string taken = install.Path() + "/taken";
    const bool made = mkdir(path.c_str(), 0700) == 0;
    // Made first by another user, or open to others.
    for (const mode_t mode : {0700, 0755}) {
        ASSERT_EQ(mkdir(taken.c_str(), mode), 0);
        std::filesystem::permissions(taken, std::filesystem::perms(mode));
        ASSERT_EQ(chown(taken.c_str(), mode == 0700 ? 65534 : getuid(), -1), 0);
        ASSERT_EQ(mount(taken.c_str(), path.c_str(), nullptr, MS_BIND, nullptr), 0);
        ProbeRun first(install.Path(), {}, env);
        ASSERT_TRUE(first.WaitForShown());
        ProbeRun second(install.Path(), {}, env);
        ASSERT_TRUE(second.WaitForExit());
        EXPECT_TRUE(second.Events("shown").empty());
        umount(path.c_str());
        rmdir(taken.c_str());
    }
    if (made)
        rmdir(path.c_str());
}

} // namespace
