#include "app/HandOver.h"

#include "platform/Ipc.h"

#include <wx/log.h>
#include <wx/utils.h>

#include <chrono>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <thread>
#include <unistd.h>

namespace {

using Clock = std::chrono::steady_clock;

const auto kServiceRetry = std::chrono::milliseconds(2000);
const auto kRetryPause = std::chrono::milliseconds(25);
// Beyond the retries, one bounded connection attempt and the poke itself.
const auto kWholeHandOver = std::chrono::milliseconds(5000);

// Ends the process when the hand-over is not done by the deadline. The toolkit's
// socket calls have no deadline of their own once connected.
class Watchdog
{
public:
    explicit Watchdog(Clock::time_point deadline)
        : m_thread([this, deadline] {
              std::unique_lock<std::mutex> lock(m_mutex);
              if (!m_done.wait_until(lock, deadline, [this] { return m_finished; }))
                  _exit(0);
          })
    {
    }
    ~Watchdog()
    {
        {
            std::lock_guard<std::mutex> lock(m_mutex);
            m_finished = true;
        }
        m_done.notify_one();
        m_thread.join();
    }

private:
    std::mutex m_mutex;
    std::condition_variable m_done;
    bool m_finished = false;
    std::thread m_thread;
};

int MillisecondsUntil(Clock::time_point deadline)
{
    const auto left =
        std::chrono::duration_cast<std::chrono::milliseconds>(deadline - Clock::now()).count();
    return left > 0 ? static_cast<int>(left) : 0;
}

} // namespace

void HandOverToRunningCopy(const wxString& service, const wxString& path)
{
    const auto start = Clock::now();
    const auto deadline = start + kWholeHandOver;
    Watchdog watchdog(deadline);
    wxLogNull quiet;

    // A refused socket path stays refused: nothing to wait for.
    if (GetServiceSocketPath(service).empty())
        return;
    IpcClient client;
    std::unique_ptr<wxConnectionBase> connection;
    for (;;) {
        connection.reset(client.Connect(
            service, "IPC START", std::min(kIpcConnectTimeoutMs, MillisecondsUntil(deadline))));
        if (connection || Clock::now() + kRetryPause > start + kServiceRetry)
            break;
        std::this_thread::sleep_for(kRetryPause);
    }
    if (!connection)
        return;

    wxString text = "Raise";
    if (!path.empty())
        text += "* " + path;
    connection->Poke("Application", text);
    connection->Disconnect();
}
