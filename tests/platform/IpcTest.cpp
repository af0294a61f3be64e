// The IPC layer: sockets only in the user's private directory and only where
// they fit, servers that remove only their own socket, and conversations with
// another process that arrive whole, are refused, or end on their deadline.
#include "platform/Ipc.h"
#include "support/GuiWait.h"
#include "support/ProbeRun.h"
#include "support/StandinDir.h"

#include <gtest/gtest.h>
#include <wx/utils.h>

#include <csignal>
#include <filesystem>
#include <memory>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>

namespace {

namespace fs = std::filesystem;

// A runtime directory of the test's own, as XDG_RUNTIME_DIR.
struct RuntimeDir
{
    RuntimeDir() : dir({})
    {
        chmod(dir.Path().c_str(), 0700);
        setenv("XDG_RUNTIME_DIR", dir.Path().c_str(), 1);
    }
    std::string Sockets() const { return dir.Path() + "/veltrona"; }
    StandinDir dir;
};

TEST(IpcTest, SocketsOnlyInAPrivateDirectoryAndOnlyWhereTheyFit)
{
    const size_t room = sizeof(sockaddr_un::sun_path) - 2 - RuntimeDir().Sockets().size();
    struct Case
    {
        mode_t folderMode; // 0: the folder is made by the layer
        bool link, foreign;
        std::string name;
        bool accepted;
    };
    const Case cases[] = {
        {0, false, false, "Help", true},
        {0, false, false, "", false},
        {0, false, false, "a/b", false},
        {0, false, false, std::string(room, 'x'), true},
        {0, false, false, std::string(room + 1, 'x'), false},
        {0700, true, false, "Help", false},
        {0755, false, false, "Help", false},
        {0710, false, false, "Help", false},
        {0700, false, true, "Help", false},
    };
    for (const Case& c : cases) {
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

TEST(IpcTest, ConversationsWithAnotherProcess)
{
    const RuntimeDir runtime;
    const StandinDir work({});
    const std::string log = work.Path() + "/viewer.log";
    wxExecuteEnv env{work.Path(), wxEnvVariableHashMap()};
    wxGetEnvMap(&env.env);
    env.env["VELTRONA_HELP_LOG"] = log;
    const char* argv[] = {VELTRONA_HELPVIEWER_PATH, nullptr};
    const long viewer = wxExecute(argv, wxEXEC_ASYNC, nullptr, &env);
    ASSERT_GT(viewer, 0);
    std::shared_ptr<void> stop(nullptr, [viewer](void*) { kill(viewer, SIGKILL); });

    IpcClient client;
    std::unique_ptr<wxConnectionBase> connection;
    ASSERT_TRUE(WaitFor([&] {
        connection.reset(client.Connect("Help", "IPC START", 500));
        return connection != nullptr;
    }));
    EXPECT_EQ(client.Connect("Help", "Application", 500), nullptr);

    // Sent as a string when the format is wxIPC_INVALID, else as raw bytes.
    const std::string longText = "LaunchPad$" + std::string(2000, 'p') + "*ü.html";
    const struct
    {
        std::string bytes;
        wxIPCFormat format;
        std::vector<std::string> logged; // kind, then its fields
    } pokes[] = {
        {longText, wxIPC_INVALID, {"poke", "Item", longText}},
        {std::string("Exit\0more", 9), wxIPC_TEXT, {"poke", "Item", "Exit"}},
        {"Raise\xff\xfe", wxIPC_UTF8TEXT, {"refused", "Item"}},
        {"Raise", wxIPC_PRIVATE, {"refused", "Item"}},
        {std::string("R\0\0\0\0\0\0\0", 8), wxIPC_UNICODETEXT, {"refused", "Item"}},
        {std::string(64 * 1024 + 1, 'x'), wxIPC_TEXT, {"refused", "Item"}},
    };
    for (const auto& poke : pokes) {
        SCOPED_TRACE(testing::Message() << &poke - pokes);
        const size_t before = ReadEventLog(log).size();
        if (poke.format == wxIPC_INVALID)
            connection->Poke("Item", wxString::FromUTF8(poke.bytes));
        else
            connection->Poke("Item", poke.bytes.data(), poke.bytes.size(), poke.format);
        ASSERT_TRUE(WaitFor([&] { return ReadEventLog(log).size() > before; }));
        const ProbeEvent line = ReadEventLog(log)[before];
        EXPECT_EQ(line.kind, poke.logged[0]);
        EXPECT_TRUE(line.fields ==
                    std::vector<std::string>(poke.logged.begin() + 1, poke.logged.end()));
    }

    // A server that stopped answering, and a socket whose owner never accepts.
    kill(viewer, SIGSTOP);
    EXPECT_EQ(client.Connect("Help", "IPC START", 300), nullptr);
    kill(viewer, SIGCONT);
    const int silent = socket(AF_UNIX, SOCK_STREAM, 0);
    sockaddr_un address = {AF_UNIX, {}};
    (runtime.Sockets() + "/Silent").copy(address.sun_path, sizeof address.sun_path - 1);
    ASSERT_EQ(bind(silent, reinterpret_cast<sockaddr*>(&address), sizeof address), 0);
    ASSERT_EQ(listen(silent, 4), 0);
    EXPECT_EQ(client.Connect("Silent", "IPC START", 300), nullptr);
    close(silent);
}

} // namespace
