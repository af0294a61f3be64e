// A stand-in for the instrument maker's library: answers from a state set
// through the control interface and delivers notifications on its own thread.
#include "varosim.h"

#include <chrono>
#include <condition_variable>
#include <cstdlib>
#include <cstring>
#include <deque>
#include <map>
#include <mutex>
#include <string>
#include <thread>
#include <utility>

namespace {

int StateFromEnvironment()
{
    const char* value = std::getenv("VARO_SIM_STATE");
    if (value == nullptr)
        return VAROSIM_NONE;
    if (std::strcmp(value, "direct") == 0)
        return VAROSIM_DIRECT;
    if (std::strcmp(value, "table") == 0)
        return VAROSIM_TABLE;
    return VAROSIM_NONE;
}

class Simulator
{
public:
    Simulator() : m_state(StateFromEnvironment()), m_thread([this] { Deliver(); }) {}

    std::mutex m_mutex;
    std::condition_variable m_changed;
    int m_state;
    int m_measureResult = 0;
    int m_measureDelay = 0;
    VaroNotifyCallback m_callback = nullptr;
    std::map<std::string, int> m_calls;
    std::map<std::string, std::string> m_options;
    std::string m_optionLog;
    std::deque<std::pair<int, int>> m_queue;
    bool m_delivering = false;

private:
    std::thread m_thread;

    void Deliver()
    {
        std::unique_lock<std::mutex> lock(m_mutex);
        for (;;) {
            m_changed.wait(lock, [this] { return !m_queue.empty(); });
            const std::pair<int, int> notification = m_queue.front();
            m_queue.pop_front();
            const VaroNotifyCallback callback = m_callback;
            m_delivering = true;
            lock.unlock();
            if (callback != nullptr)
                callback(notification.first, notification.second);
            lock.lock();
            m_delivering = false;
            m_changed.notify_all();
        }
    }
};

// Never destroyed: its thread ends with the process. Joining it while the library
// is taken down would deadlock on Windows, which does that under its loader lock
// after it has already ended every other thread.
Simulator& Sim()
{
    static Simulator& simulator = *new Simulator;
    return simulator;
}

} // namespace

extern "C" {

void VaroRegisterCallback(VaroNotifyCallback callback)
{
    Simulator& sim = Sim();
    std::lock_guard<std::mutex> lock(sim.m_mutex);
    ++sim.m_calls["VaroRegisterCallback"];
    sim.m_callback = callback;
}

int VaroCheckInstrument(void)
{
    Simulator& sim = Sim();
    std::lock_guard<std::mutex> lock(sim.m_mutex);
    ++sim.m_calls["VaroCheckInstrument"];
    return sim.m_state == VAROSIM_NONE ? 1 : 0;
}

int VaroCheckTableMount(void)
{
    Simulator& sim = Sim();
    std::lock_guard<std::mutex> lock(sim.m_mutex);
    ++sim.m_calls["VaroCheckTableMount"];
    return sim.m_state == VAROSIM_TABLE ? 0 : 1;
}

void VaroSetOption(const char* name, const char* value)
{
    Simulator& sim = Sim();
    std::lock_guard<std::mutex> lock(sim.m_mutex);
    ++sim.m_calls["VaroSetOption"];
    if (name == nullptr || value == nullptr)
        return;
    sim.m_options[name] = value;
    sim.m_optionLog.append(name).append("=").append(value).append("\n");
}

const char* VaroGetOption(const char* name)
{
    Simulator& sim = Sim();
    std::lock_guard<std::mutex> lock(sim.m_mutex);
    ++sim.m_calls["VaroGetOption"];
    // The text stays valid until the option is set again, as the client expects.
    return name == nullptr ? "" : sim.m_options[name].c_str();
}

int VaroMeasure(void)
{
    Simulator& sim = Sim();
    int delay;
    {
        std::lock_guard<std::mutex> lock(sim.m_mutex);
        ++sim.m_calls["VaroMeasure"];
        delay = sim.m_measureDelay;
    }
    if (delay > 0)
        std::this_thread::sleep_for(std::chrono::milliseconds(delay));
    std::lock_guard<std::mutex> lock(sim.m_mutex);
    return sim.m_measureResult;
}

void varosim_set_state(int state)
{
    Simulator& sim = Sim();
    std::lock_guard<std::mutex> lock(sim.m_mutex);
    sim.m_state = state;
}

void varosim_set_measure_result(int result)
{
    Simulator& sim = Sim();
    std::lock_guard<std::mutex> lock(sim.m_mutex);
    sim.m_measureResult = result;
}

void varosim_set_measure_delay(int milliseconds)
{
    Simulator& sim = Sim();
    std::lock_guard<std::mutex> lock(sim.m_mutex);
    sim.m_measureDelay = milliseconds;
}

void varosim_fire(int code, int data)
{
    Simulator& sim = Sim();
    {
        std::lock_guard<std::mutex> lock(sim.m_mutex);
        sim.m_queue.emplace_back(code, data);
    }
    sim.m_changed.notify_all();
}

int varosim_wait_idle(int timeoutMilliseconds)
{
    Simulator& sim = Sim();
    std::unique_lock<std::mutex> lock(sim.m_mutex);
    const bool idle =
        sim.m_changed.wait_for(lock, std::chrono::milliseconds(timeoutMilliseconds),
                               [&sim] { return sim.m_queue.empty() && !sim.m_delivering; });
    return idle ? 0 : -1;
}

int varosim_calls(const char* function)
{
    Simulator& sim = Sim();
    std::lock_guard<std::mutex> lock(sim.m_mutex);
    const auto found = sim.m_calls.find(function == nullptr ? "" : function);
    return found == sim.m_calls.end() ? 0 : found->second;
}

size_t varosim_option_log(char* buffer, size_t size)
{
    Simulator& sim = Sim();
    std::lock_guard<std::mutex> lock(sim.m_mutex);
    const std::string& log = sim.m_optionLog;
    if (buffer != nullptr && size > 0) {
        const size_t copied = log.size() < size ? log.size() : size - 1;
        std::memcpy(buffer, log.data(), copied);
        buffer[copied] = '\0';
    }
    return log.size();
}

} // extern "C"
