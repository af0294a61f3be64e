// Reaches the control interface of the instrument simulator that the client
// loaded: the libvaro.so beside the running test executable.
#pragma once

#include "varosim.h"

#include <string>

class VaroSimControl
{
public:
    // Opens the simulator; fails the test that asks when it is not there.
    VaroSimControl();
    ~VaroSimControl();

    void SetState(int state) const { m_setState(state); }
    void SetMeasureResult(int result) const { m_setMeasureResult(result); }
    void SetMeasureDelay(int milliseconds) const { m_setMeasureDelay(milliseconds); }
    void Fire(int code, int data = 0) const { m_fire(code, data); }
    // True when every fired notification has been handed to the client in time.
    bool WaitIdle() const { return m_waitIdle(10000) == 0; }
    int Calls(const char* function) const { return m_calls(function); }
    std::string OptionLog() const;

    bool IsOpen() const { return m_handle != nullptr; }

private:
    template <typename Function> void Resolve(Function& function, const char* name);

    void* m_handle;
    decltype(&varosim_set_state) m_setState;
    decltype(&varosim_set_measure_result) m_setMeasureResult;
    decltype(&varosim_set_measure_delay) m_setMeasureDelay;
    decltype(&varosim_fire) m_fire;
    decltype(&varosim_wait_idle) m_waitIdle;
    decltype(&varosim_calls) m_calls;
    decltype(&varosim_option_log) m_optionLog;
};
