// The raise service between two real copies of the launcher, peers that stall
// or lie to it, and the rules by which the running copy reads a poke.
#include "app/Veltro3App.h"
#include "app/Veltro3AppLauncherIPC.h"
#include "frame/Veltro3AppFrame.h"

#include "support/DesktopTools.h"
#include "support/GuiWait.h"
#include "support/ProbeRun.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gtest/gtest.h>
#include <wx/utils.h>

#include <csignal>
#include <cstring>
#include <filesystem>
#include <poll.h>
#include <set>
#include <sys/socket.h>
#include <sys/un.h>

namespace {

// A socket connected to `path` (listening there when `listening`) that has sent `bytes`.
int OpenSocket(const std::string& path, const std::string& bytes, bool listening = false)
{
    const int fd = socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
    sockaddr_un address = {};
    address.sun_family = AF_UNIX;
    std::strcpy(address.sun_path, path.c_str());
    const auto* at = reinterpret_cast<const sockaddr*>(&address);
    EXPECT_EQ(listening ? bind(fd, at, sizeof address) + listen(fd, 64)
                        : connect(fd, at, sizeof address),
              0);
    send(fd, bytes.data(), bytes.size(), MSG_NOSIGNAL);
    return fd;
}

bool EndedByPeer(int fd)
{
    char bytes[64];
    ssize_t got;
    while ((got = recv(fd, bytes, sizeof bytes, MSG_DONTWAIT)) > 0)
        ;
    return got == 0 || errno != EAGAIN;
}

std::string Block(const std::string& bytes, uint32_t size)
{
    return std::string{char(size), char(size >> 8), char(size >> 16), char(size >> 24)} + bytes;
}

TEST(RaiseServiceTest, LaterCopiesRaiseTheFirstAndHandTheirFilesOver)
{
    StandinDir install({"Quenta Inspect Studio.exe"}), profiles({});
    const std::string log = install.Path() + "/starts.log";
    const EnvList env = {{"XDG_RUNTIME_DIR", install.Path()},
                         {"VELTRONA_STANDIN_LOG", log},
                         {"VELTRONA_STANDIN_EXIT", "1"}};
    auto handOver = [&](const Args& args, bool delivered = true) {
        ProbeRun second(install.Path(), args, env, {"", "", profiles.Path()});
        EXPECT_EQ(second.ExitCode(), delivered ? 0 : 1);
        EXPECT_TRUE(second.Events().empty()) << "a later copy shows nothing";
    };

    // Files sent while the first copy is still in its splash time wait for the frame.
    const std::string socket =
        install.Path() + "/veltrona/Zelgrave.Veltrona." + wxGetUserId().utf8_string() + ".ipc";
    ProbeRun first(install.Path(), {}, env);
    ASSERT_TRUE(WaitFor([&] { return std::filesystem::is_socket(socket); }));
    handOver({"early.icc"});
    ASSERT_TRUE(first.WaitForShown());
    // Relative to the later copy's folder, only the first argument, whole, never expanded.
    const std::string odd = "sub dir/a*b\\n\t" + std::string(2000, 'p') + "\n.icc";
    handOver({odd, "/ignored.icc"});

    const std::multiset<Args> expected = {{profiles.Path() + "/early.icc"},
                                          {profiles.Path() + "/" + odd}};
    std::multiset<Args> opened;
    for (const StandinRecord& record : WaitForRecords(log, expected.size()))
        opened.insert(record.args);
    EXPECT_EQ(opened, expected);

    // Without a file, a later copy restores the minimised frame.
    const unsigned long frame = first.Window();
    MinimiseWindow(frame);
    ASSERT_TRUE(WaitFor([&] { return IsMinimised(frame); }));
    handOver({});
    EXPECT_TRUE(WaitFor([&] { return !IsMinimised(frame); }));

    // A frozen first copy keeps no later copy waiting, and gets nothing from it.
    kill(first.Pid(), SIGSTOP);
    handOver({"frozen.icc"}, false);
    kill(first.Pid(), SIGCONT);
    CloseWindow(frame);
    ASSERT_TRUE(first.WaitForExit());
    EXPECT_EQ(SettledRecords(log).size(), expected.size());
}

// Peers that stall or lie, met while a help request waits for a viewer that never answers:
// the launcher drops each of them, and a later copy's file reaches Inspect meanwhile.
TEST(RaiseServiceTest, HostilePeersAndASlowViewerNeitherStallTheLauncherNorLoseAFile)
{
    StandinDir install({"Quenta Inspect Studio.exe", "Help/Veltrona Help.exe"}), profiles({});
    const std::string log = install.Path() + "/starts.log", sockets = install.Path() + "/veltrona/";
    const EnvList env = {{"XDG_RUNTIME_DIR", install.Path()},
                         {"VELTRONA_STANDIN_LOG", log},
                         {"VELTRONA_STANDIN_EXIT", "1"}};
    const std::string raise = sockets + "Zelgrave.Veltrona." + wxGetUserId().utf8_string() + ".ipc";
    EnvList withHelp = env;
    withHelp.push_back({"VELTRONA_PROBE_COMMAND", "1015"});
    ProbeRun first(install.Path(), {}, withHelp);
    ASSERT_TRUE(WaitFor([&] { return std::filesystem::is_socket(raise); }));
    const int viewer = OpenSocket(sockets + "Help", "", true);
    ASSERT_TRUE(first.WaitForShown());
    pollfd asked = {viewer, POLLIN, 0};
    ASSERT_TRUE(WaitFor([&] { return poll(&asked, 1, 0) == 1; })) << "F1 tries the viewer";

    const std::string connect = "\x0a" + Block("IPC START", 9);
    const struct
    {
        std::string socket, bytes;
    } peers[] = {
        {raise, ""},                             // silent
        {raise, "\x0a" + Block("IPC", 9)},       // half a topic
        {raise, "\x0a" + Block("", 0xffffffff)}, // a 4 GiB topic
        // a 4 GiB poke after a proper topic
        {raise, connect + "\x03" + Block("Application", 11) + "\x01" + Block("", 0xffffffff)},
        {sockets + "LaunchPad", ""},                                          // silent
        {sockets + "LaunchPad", connect + "\x03" + Block("Application", 11)}, // half a poke
    };
    std::vector<int> open;
    std::multiset<Args> files, opened;
    for (const auto& peer : peers) {
        SCOPED_TRACE(&peer - peers);
        open.push_back(OpenSocket(peer.socket, peer.bytes));
        const std::string file = profiles.Path() + "/" + std::to_string(&peer - peers) + ".icc";
        files.insert({file});
        ASSERT_EQ(ProbeRun(install.Path(), {file}, env).ExitCode(), 0);
    }
    for (const StandinRecord& record : WaitForRecords(log, files.size() + 1)) // and the viewer's
        if (!record.args.empty())
            opened.insert(record.args);
    EXPECT_EQ(opened, files);
    for (size_t i = 0; i < open.size(); ++i) {
        EXPECT_TRUE(WaitFor([&] { return EndedByPeer(open[i]); })) << i;
        close(open[i]);
    }

    // Its frame still closes with a silent peer connected, and the process ends.
    const int silent = OpenSocket(raise, "");
    CloseWindow(first.Window());
    EXPECT_TRUE(first.WaitForExit());
    close(silent);
    close(viewer);
}

// Each poke on its own, to a running copy whose frame is still hidden.
TEST(RaiseServiceTest, OnlyWellFormedRaisePokesAreProcessed)
{
    EXPECT_EQ(Veltro3AppLauncherIPCServer().OnAcceptConnection("Application"), nullptr);
    Veltro3App* app = GetVeltro3App();
    ASSERT_NE(app, nullptr);
    app->m_frame = new Veltro3AppFrame("Veltrona", wxDefaultPosition, wxDefaultSize);
    app->SetTopWindow(app->m_frame);
    app->m_deferredStartupPending = true;

    const struct
    {
        std::string item, data;
        wxIPCFormat format;
        bool processed;
    } cases[] = {
        {"Application", "Raise", wxIPC_UTF8TEXT, true},
        {"Application", "Raise* ", wxIPC_UTF8TEXT, true},
        {"Application", std::string("Raise* /a.icc\0/b.icc", 20), wxIPC_UTF8TEXT, true},
        {"Application", "Raise* /x*y.icc", wxIPC_TEXT, true},
        {"Application", "raise* /c.icc", wxIPC_UTF8TEXT, false},
        {"application", "Raise* /d.icc", wxIPC_UTF8TEXT, false},
        {"Application", "Raise*", wxIPC_UTF8TEXT, false},
        {"Application", "Raise*/e.icc", wxIPC_UTF8TEXT, false},
    };
    Veltro3AppLauncherIPCConnection connection;
    connection.SetConnected(false); // no peer: the pokes are handed to it directly
    for (const auto& c : cases)
        EXPECT_EQ(connection.OnPoke("IPC START", c.item, c.data.data(), c.data.size(), c.format),
                  c.processed)
            << c.data.substr(0, 40);
    // Paths that arrived before the frame showed wait, in order, cut at the NUL.
    EXPECT_EQ(std::vector<wxString>(app->m_queuedFiles.begin(), app->m_queuedFiles.end()),
              (std::vector<wxString>{"/a.icc", "/x*y.icc"}));

    // A frame on its way out is not touched.
    app->m_frame->Destroy();
    EXPECT_FALSE(connection.OnPoke("IPC START", "Application", "Raise", 6, wxIPC_UTF8TEXT));
    app->m_frame = nullptr;
    app->m_queuedFiles.clear();
}

} // namespace
