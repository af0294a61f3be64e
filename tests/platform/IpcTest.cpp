// The IPC layer's sockets (connections that end on their deadline: RaiseServiceTest).
#include "platform/Ipc.h"
#include "support/StandinDir.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <memory>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>

namespace {

namespace fs = std::filesystem;

// A runtime directory of the test's own (made private by mkdtemp), as XDG_RUNTIME_DIR.
struct RuntimeDir
{
    RuntimeDir() : dir({}) { setenv("XDG_RUNTIME_DIR", dir.Path().c_str(), 1); }
    std::string Sockets() const { return dir.Path() + "/veltrona"; }
    StandinDir dir;
};

TEST(IpcTest, SocketsOnlyInAPrivateDirectoryAndOnlyWhereTheyFit)
{
    const size_t room = sizeof(sockaddr_un::sun_path) - 2 - RuntimeDir().Sockets().size();
    const struct
    {
        mode_t folderMode; // 0: the folder is made by the layer
        bool link, foreign;
        std::string name;
        bool accepted;
    } cases[] = {
        {0, false, false, "Help", true},
        {0, false, false, "", false},
        {0, false, false, "../Help", false},
        {0, false, false, std::string(room, 'x'), true},
        {0, false, false, std::string(room + 1, 'x'), false},
        {0700, true, false, "Help", false},
        {0750, false, false, "Help", false},
        {0700, false, true, "Help", false},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(testing::Message() << &c - cases);
        const RuntimeDir runtime;
        const std::string folder = runtime.Sockets() + (c.link ? "-real" : "");
        if (c.folderMode) {
            mkdir(folder.c_str(), 0700);
            chmod(folder.c_str(), c.folderMode);
        }
        if (c.link)
            symlink(folder.c_str(), runtime.Sockets().c_str());
        if (c.foreign) {
            ASSERT_EQ(chown(folder.c_str(), getuid() + 1, getgid()), 0) << "needs root";
        }
        IpcServer server;
        EXPECT_EQ(server.Create(wxString::FromUTF8(c.name)), c.accepted);
        EXPECT_EQ(fs::is_socket(runtime.Sockets() + "/" + c.name), c.accepted);
    }
}

TEST(IpcTest, ServerRemovesOnlyItsOwnSocket)
{
    const RuntimeDir runtime;
    const std::string path = runtime.Sockets() + "/LaunchPad";
    auto older = std::make_unique<IpcServer>(), newer = std::make_unique<IpcServer>();
    ASSERT_TRUE(older->Create("LaunchPad") && newer->Create("LaunchPad"));
    struct stat before, after;
    ASSERT_EQ(lstat(path.c_str(), &before), 0);
    older.reset();
    ASSERT_EQ(lstat(path.c_str(), &after), 0) << "the newer server's socket was removed";
    EXPECT_EQ(after.st_ino, before.st_ino);
    newer.reset();
    EXPECT_FALSE(fs::exists(path));
}

} // namespace
