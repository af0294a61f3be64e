// The raise service between two real copies of the launcher, and the rules by
// which the running copy reads a poke.
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
#include <filesystem>
#include <set>

namespace {

using Args = std::vector<std::string>;

TEST(RaiseServiceTest, LaterCopiesRaiseTheFirstAndHandTheirFilesOver)
{
    StandinDir install({"Quenta Inspect Studio.exe"}), profiles({});
    const std::string log = install.Path() + "/starts.log";
    const EnvList env = {{"XDG_RUNTIME_DIR", install.Path()},
                         {"VELTRONA_STANDIN_LOG", log},
                         {"VELTRONA_STANDIN_EXIT", "1"}};
    auto handOver = [&](const Args& args) {
        ProbeRun second(install.Path(), args, env, {"", "", profiles.Path()});
        int status = 0;
        EXPECT_TRUE(second.WaitForExit(10000, status));
        EXPECT_TRUE(second.Events().empty()) << "a later copy shows nothing";
    };

    // Once the first copy's service is there, it is still in its splash time:
    // files sent now wait for the frame.
    const std::string socket =
        install.Path() + "/veltrona/Zelgrave.Veltrona." + wxGetUserId().utf8_string() + ".ipc";
    ProbeRun first(install.Path(), {}, env);
    ASSERT_TRUE(WaitFor([&] { return std::filesystem::is_socket(socket); }));
    handOver({"early.icc"});
    ASSERT_TRUE(first.WaitForShown());
    // Relative to the later copy's folder, only the first argument, whole and
    // never expanded.
    const std::string odd = "sub dir/a*b" + std::string(2000, 'p') + ".icc";
    handOver({odd, "/ignored.icc"});

    const std::multiset<Args> expected = {{profiles.Path() + "/early.icc"},
                                          {profiles.Path() + "/" + odd}};
    std::multiset<Args> opened;
    for (const StandinRecord& record : WaitForRecords(log, expected.size()))
        opened.insert(record.args);
    EXPECT_EQ(opened, expected);

    // Without a file, a later copy restores the minimised frame.
    unsigned long frame = 0;
    ASSERT_TRUE(WaitFor([&] { return (frame = WindowOf(first.Pid(), "Veltrona")) != 0; }));
    MinimiseWindow(frame);
    ASSERT_TRUE(WaitFor([&] { return IsMinimised(frame); }));
    handOver({});
    EXPECT_TRUE(WaitFor([&] { return !IsMinimised(frame); }));

    // A frozen first copy keeps no later copy waiting, and gets nothing from it.
    kill(first.Pid(), SIGSTOP);
    handOver({"frozen.icc"});
    kill(first.Pid(), SIGCONT);
    CloseWindow(frame);
    int status = 0;
    ASSERT_TRUE(first.WaitForExit(10000, status));
    EXPECT_EQ(SettledRecords(log).size(), expected.size());
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
        {"Application", "Raise* /\xc3(.icc", wxIPC_UTF8TEXT, false},
        {"Application", "Raise* /f.icc", wxIPC_PRIVATE, false},
        {"Application", "Raise* /" + std::string(kIpcMaxPokeSize, 'x'), wxIPC_UTF8TEXT, false},
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
