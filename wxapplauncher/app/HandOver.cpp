#include "app/HandOver.h"

#include "platform/Ipc.h"

#include <wx/log.h>

#include <algorithm>
#include <chrono>
#include <memory>
#include <thread>

namespace {

using Clock = std::chrono::steady_clock;

const auto kServiceRetry = std::chrono::milliseconds(2000);
const auto kRetryPause = std::chrono::milliseconds(25);
// Beyond the retries, one bounded connection attempt and the poke itself.
const auto kWholeHandOver = std::chrono::milliseconds(5000);

} // namespace

bool HandOverToRunningCopy(const wxString& service, const wxString& path)
{
    const auto start = Clock::now();
    wxLogNull quiet;

    // A refused service name stays refused: nothing to wait for.
    if (!IsServiceNameUsable(service))
        return false;
    IpcClient client;
    std::unique_ptr<wxConnectionBase> connection;
    for (;;) {
        const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(
                              start + kWholeHandOver - Clock::now())
                              .count();
        connection.reset(client.Connect(service, "IPC START",
                                        static_cast<int>(std::min<long long>(
                                            kIpcConnectTimeoutMs, std::max<long long>(left, 0)))));
        if (connection || Clock::now() + kRetryPause > start + kServiceRetry)
            break;
        std::this_thread::sleep_for(kRetryPause);
    }
    if (!connection)
        return false;

    wxString text = "Raise";
    if (!path.empty())
        text += "* " + path;
    return connection->Poke("Application", text);
}
