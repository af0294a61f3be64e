// The IPC layer: sockets only in the user's private directory, conversations
// with another process that arrive whole or are refused, connection attempts
// that end however the server behaves, and servers that remove only their own
// socket.
#include "platform/Ipc.h"
#include "support/GuiWait.h"
#include "support/StandinDir.h"
#include "support/ViewerLog.h"

#include <gtest/gtest.h>
#include <wx/utils.h>

#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <functional>
#include <memory>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>

namespace {

namespace fs = std::filesystem;

// A private runtime directory of the test's own, as XDG_RUNTIME_DIR.
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
    struct Case
    {
        const char* what;
        std::function<void(const std::string& sockets)> prepare;
        size_t nameLength; // a name of this many "x" when `name` is empty
        std::string name;
        bool accepted;
    };
    const auto none = [](const std::string&) {};
    const auto privateDir = [](const std::string& sockets) { mkdir(sockets.c_str(), 0700); };
    const RuntimeDir probe;
    const size_t room = sizeof(sockaddr_un::sun_path) - 1 - (probe.Sockets().size() + 1);
    const std::vector<Case> cases = {
        {"a plain name", none, 0, "Help", true},
        {"an empty name", none, 0, "", false},
        {"a name with a separator", none, 0, "a/b", false},
        {"the parent folder", none, 0, "..", false},
        {"the longest path that fits", none, room, "", true},
        {"a path one byte too long", none, room + 1, "", false},
        {"a link to a private folder",
         [](const std::string& sockets) {
             mkdir((sockets + "-real").c_str(), 0700);
             symlink((sockets + "-real").c_str(), sockets.c_str());
         },
         0, "Help", false},
        {"a folder open to others",
         [](const std::string& sockets) {
             mkdir(sockets.c_str(), 0700);
             chmod(sockets.c_str(), 0755);
         },
         0, "Help", false},
        {"a folder open to the group",
         [](const std::string& sockets) {
             mkdir(sockets.c_str(), 0700);
             chmod(sockets.c_str(), 0710);
         },
         0, "Help", false},
        {"another user's folder",
         [privateDir](const std::string& sockets) {
             privateDir(sockets);
             if (chown(sockets.c_str(), getuid() + 1, getgid()) != 0)
                 GTEST_SKIP() << "changing a folder's owner needs root";
         },
         0, "Help", false},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.what);
        const RuntimeDir runtime;
        c.prepare(runtime.Sockets());
        const std::string name = c.name.empty() ? std::string(c.nameLength, 'x') : c.name;
        const wxString path = GetServiceSocketPath(wxString::FromUTF8(name));
        IpcServer server;
        const bool created = server.Create(wxString::FromUTF8(name));
        EXPECT_EQ(created, c.accepted);
        if (c.accepted) {
            EXPECT_EQ(path.utf8_string(), runtime.Sockets() + "/" + name);
            struct stat info;
            EXPECT_TRUE(stat(path.utf8_str(), &info) == 0 && S_ISSOCK(info.st_mode));
        } else {
            EXPECT_TRUE(path.empty()) << path;
            IpcClient client;
            EXPECT_EQ(client.Connect(wxString::FromUTF8(name), "IPC START", 200), nullptr);
        }
    }
}

TEST(IpcTest, ServerRemovesOnlyItsOwnSocket)
{
    const RuntimeDir runtime;
    const std::string path = runtime.Sockets() + "/LaunchPad";
    auto older = std::make_unique<IpcServer>();
    ASSERT_TRUE(older->Create("LaunchPad"));
    auto newer = std::make_unique<IpcServer>();
    ASSERT_TRUE(newer->Create("LaunchPad"));
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
    const StandinDir install({});
    const std::string log = install.Path() + "/viewer.log";
    wxExecuteEnv env{install.Path(), wxEnvVariableHashMap()};
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

    struct Poke
    {
        const char* what;
        std::string bytes; // sent through the untyped overload when `format` is set
        wxIPCFormat format;
        ViewerLine logged;
    };
    const std::string longText = "LaunchPad$" + std::string(2000, 'p') + "*ü.html";
    const std::vector<Poke> pokes = {
        {"a long text", longText, wxIPC_INVALID, {"poke", "Application", longText}},
        {"text after a NUL", std::string("Exit\0more", 9), wxIPC_TEXT, {"poke", "Item", "Exit"}},
        {"broken UTF-8", "Raise\xff\xfe", wxIPC_UTF8TEXT, {"refused", "Item"}},
        {"binary data", "Raise", wxIPC_PRIVATE, {"refused", "Item"}},
        {"wide text", std::string("R\0\0\0\0\0\0\0", 8), wxIPC_UNICODETEXT, {"refused", "Item"}},
        {"more than 64 KiB", std::string(64 * 1024 + 1, 'x'), wxIPC_TEXT, {"refused", "Item"}},
    };
    for (const Poke& poke : pokes) {
        SCOPED_TRACE(poke.what);
        const size_t before = ReadViewerLog(log).size();
        if (poke.format == wxIPC_INVALID)
            connection->Poke("Application", wxString::FromUTF8(poke.bytes));
        else
            connection->Poke("Item", poke.bytes.data(), poke.bytes.size(), poke.format);
        ASSERT_TRUE(WaitFor([&] { return ReadViewerLog(log).size() > before; }));
        const ViewerLine line = ReadViewerLog(log)[before];
        EXPECT_TRUE(line == poke.logged) << line.front() << " " << line.size() << " fields";
    }

    // A server that has stopped answering: the attempt ends on its deadline.
    kill(viewer, SIGSTOP);
    EXPECT_EQ(client.Connect("Help", "IPC START", 300), nullptr);
    kill(viewer, SIGCONT);
    connection.reset(client.Connect("Help", "IPC START", 5000));
    EXPECT_NE(connection, nullptr);

    // A socket whose owner never accepts: a connect that the kernel completes.
    const std::string silentPath = runtime.Sockets() + "/Silent";
    const int silent = socket(AF_UNIX, SOCK_STREAM, 0);
    sockaddr_un address = {};
    address.sun_family = AF_UNIX;
    silentPath.copy(address.sun_path, silentPath.size());
    ASSERT_EQ(bind(silent, reinterpret_cast<sockaddr*>(&address), sizeof address), 0);
    ASSERT_EQ(listen(silent, 4), 0);
    EXPECT_EQ(client.Connect("Silent", "IPC START", 300), nullptr);
    close(silent);
}

} // namespace
