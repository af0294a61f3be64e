// Times the updater's work in the deferred start-up (reading the shared
// settings with the schedule decision, and the clean-up of the temporary
// directory), each beside the bare toolkit call it is built on.
#include "settings/UpdateCheck.h"

#include <wx/dir.h>
#include <wx/fileconf.h>
#include <wx/init.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <functional>
#include <string>
#include <unistd.h>

namespace fs = std::filesystem;

namespace {

const int kRuns = 200;

double MicrosecondsPerRun(const std::function<void()>& work)
{
    const auto start = std::chrono::steady_clock::now();
    for (int i = 0; i < kRuns; ++i)
        work();
    const std::chrono::duration<double, std::micro> spent =
        std::chrono::steady_clock::now() - start;
    return spent.count() / kRuns;
}

} // namespace

int main()
{
    wxInitializer toolkit;
    const fs::path root =
        fs::temp_directory_path() / ("veltrona-bench-" + std::to_string(getpid()));
    const fs::path settings = root / "config/Zelgrave/Zel Updater.conf";
    fs::create_directories(settings.parent_path());
    fs::create_directories(root / "tmp");
    std::ofstream out(settings);
    out << "Next\\ Launch=Never\nSilent=0\n";
    for (int i = 0; i < 20; ++i)
        out << "[Group" << i << "]\nkey=value " << i << "\n";
    out.close();
    // A busy shared temporary directory: 2000 files of other programs.
    for (int i = 0; i < 2000; ++i)
        std::ofstream(root / "tmp" / ("other-" + std::to_string(i)));
    setenv("XDG_CONFIG_HOME", (root / "config").c_str(), 1);
    setenv("XDG_CONFIG_DIRS", (root / "none").c_str(), 1);
    setenv("TMPDIR", (root / "tmp").c_str(), 1);

    const double schedule = MicrosecondsPerRun(CheckForUpdateAtLaunch);
    const double configRead = MicrosecondsPerRun([&] {
        wxFileConfig config("Zel Updater", "Zelgrave", settings.string(), wxString(),
                            wxCONFIG_USE_LOCAL_FILE);
        config.Read("Next Launch", wxString());
    });
    const double cleanUp = MicrosecondsPerRun(RemoveUpdaterTempFiles);
    const double listing = MicrosecondsPerRun([&] {
        wxArrayString files;
        wxDir::GetAllFiles((root / "tmp").string(), &files, "ZELUPDATE_*", wxDIR_FILES);
    });
    std::printf(
        "schedule check (settings read, \"Never\"): %.0f us   anchor wxFileConfig read: %.0f us\n",
        schedule, configRead);
    std::printf(
        "temporary files clean-up (2000 other files): %.0f us   anchor wxDir listing: %.0f us\n",
        cleanUp, listing);
    fs::remove_all(root);
    return 0;
}
