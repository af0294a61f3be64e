// Stands in for one of the suite's programs: records how it was started and,
// unless told to exit at once, shows a window until it is closed.
#include "StandinRecord.h"
#include "StandinWindow.h"
#include "UpdaterSettings.h"

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <unistd.h>

namespace {

const char* Env(const char* name)
{
    const char* value = std::getenv(name);
    return value && *value ? value : nullptr;
}

std::string BaseName(const std::string& path)
{
    size_t slash = path.rfind('/');
    return slash == std::string::npos ? path : path.substr(slash + 1);
}

} // namespace

int main(int argc, char** argv)
{
    std::vector<std::string> arguments(argv, argv + argc);

    if (const char* log = Env("VELTRONA_STANDIN_LOG")) {
        // The updater also tells how the launcher marked its start.
        std::vector<std::pair<std::string, std::string>> extra;
        if (!arguments.empty() && BaseName(arguments.front()) == "Quenta Updater.exe") {
            if (auto silent = standin::FindSilentSetting())
                extra.emplace_back("silent", *silent);
        }
        std::string record = standin::FormatRecord(arguments, static_cast<long>(getpid()),
                                                   standin::CurrentDirectory(), extra);
        if (!standin::AppendRecord(log, record))
            std::fprintf(stderr, "cannot append the start record to %s\n", log);
    }

    const char* exitAtOnce = Env("VELTRONA_STANDIN_EXIT");
    if (exitAtOnce && std::strcmp(exitAtOnce, "1") == 0)
        return 0;

    const char* ready = Env("VELTRONA_STANDIN_READY");
    std::vector<std::string> shownArgs(arguments.empty() ? arguments.end() : arguments.begin() + 1,
                                       arguments.end());
    int status = standin::RunWindow(BaseName(arguments.empty() ? std::string() : arguments.front()),
                                    shownArgs, ready ? ready : "");
    if (status != 0)
        std::fprintf(stderr, "cannot open the display\n");
    return status;
}
