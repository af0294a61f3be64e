// Stands in for one of the suite's programs: records how it was started and,
// unless told to exit at once, shows a window until it is closed.
#include "StandinProcess.h"
#include "StandinRecord.h"
#include "StandinWindow.h"
#include "UpdaterSettings.h"

#include <cstdio>

int main(int argc, char** argv)
{
    const std::vector<std::string> arguments = standin::ProgramArguments(argc, argv);
    const std::string program = arguments.empty() ? std::string() : arguments.front();

    const std::string log = standin::EnvironmentValue("VELTRONA_STANDIN_LOG");
    if (!log.empty()) {
        // The updater also tells how the launcher marked its start.
        std::vector<std::pair<std::string, std::string>> extra;
        if (standin::BaseName(program) == "Quenta Updater.exe") {
            if (auto silent = standin::FindSilentSetting())
                extra.emplace_back("silent", *silent);
        }
        std::string record = standin::FormatRecord(arguments, standin::ProcessId(),
                                                   standin::CurrentDirectory(), extra);
        if (!standin::AppendRecord(log, record))
            std::fprintf(stderr, "cannot append the start record to %s\n", log.c_str());
    }

    if (standin::EnvironmentValue("VELTRONA_STANDIN_EXIT") == "1")
        return 0;

    std::vector<std::string> shownArgs(arguments.empty() ? arguments.end() : arguments.begin() + 1,
                                       arguments.end());
    int status = standin::RunWindow(standin::BaseName(program), shownArgs,
                                    standin::EnvironmentValue("VELTRONA_STANDIN_READY"));
    if (status != 0)
        std::fprintf(stderr, "cannot open the display\n");
    return status;
}
