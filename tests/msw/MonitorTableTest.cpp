// The real launcher with Varo.dll beside it, reached by ordinal: File > "Create Monitor
// Profile..." is refused with a message while the simulated instrument is on its table.
// The library it is given answers by those ordinals alone, as the vendor's does.
#include "support/GuiWait.h"
#include "support/ProbeRun.h"
#include "support/StandinDir.h"
#include "support/StandinLog.h"

#include <gtest/gtest.h>
#include <wx/filefn.h>

#include <windows.h>

#include <set>

namespace {

TEST(MonitorTableTest, MonitorIsRefusedOnlyWhileTheInstrumentIsOnTheTable)
{
    const struct
    {
        const char* state;
        bool starts;
    } cases[] = {{"table", false}, {"direct", true}, {"none", true}};
    for (const auto& test : cases) {
        SCOPED_TRACE(test.state);
        StandinDir install({"Monitor/Zel Display Studio.exe"});
        ASSERT_TRUE(wxCopyFile(VELTRONA_VARO_PATH, install.Path() + "\\Varo.dll"));
        const std::string log = install.Path() + "\\starts.log";
        ProbeRun launcher(install.Path(), {},
                          {{"VARO_SIM_STATE", test.state},
                           {"VELTRONA_PROBE_COMMAND", "1002"},
                           {"VELTRONA_STANDIN_LOG", log},
                           {"VELTRONA_STANDIN_EXIT", "1"}});
        ASSERT_TRUE(WaitFor([&] { return launcher.Events("command").size() == 2; }, 60000))
            << "the menu command's start and end";
        const auto records = SettledRecords(log, launcher.Pid());
        const auto dialogs = launcher.Events("dialog");
        ASSERT_EQ(records.size(), test.starts ? 1u : 0u);
        ASSERT_EQ(dialogs.size(), test.starts ? 0u : 1u);
        if (!test.starts) {
            EXPECT_EQ(dialogs[0].fields[0], "Please remove the Zel Varo from the Orbis table.\n"
                                            "Connect directly to the Zel Varo and try again.");
        }
    }
}

TEST(MonitorTableTest, TheLibraryExportsItsSixFunctionsByOrdinalOnly)
{
    // Not run: only its export table is read.
    const HMODULE library =
        LoadLibraryExA(VELTRONA_VARO_PATH, nullptr, DONT_RESOLVE_DLL_REFERENCES);
    ASSERT_NE(library, nullptr) << VELTRONA_VARO_PATH;
    const std::set<int> ordinals = {5, 11, 12, 14, 18, 23};
    for (int ordinal = 1; ordinal < 1024; ++ordinal)
        EXPECT_EQ(GetProcAddress(library, MAKEINTRESOURCEA(ordinal)) != nullptr,
                  ordinals.count(ordinal) == 1)
            << "ordinal " << ordinal;
    for (const char* name :
         {"VaroMeasure", "VaroCheckTableMount", "varosim_set_state", "varosim_fire"})
        EXPECT_EQ(GetProcAddress(library, name), nullptr) << name;
    FreeLibrary(library);
}

} // namespace
