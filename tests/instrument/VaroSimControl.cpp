#include "instrument/VaroSimControl.h"

#include <dlfcn.h>
#include <gtest/gtest.h>
#include <wx/filename.h>
#include <wx/stdpaths.h>

VaroSimControl::VaroSimControl()
    : m_setState(nullptr), m_setMeasureResult(nullptr), m_setMeasureDelay(nullptr), m_fire(nullptr),
      m_waitIdle(nullptr), m_calls(nullptr), m_optionLog(nullptr)
{
    // The same file the client loads, so both share one simulated instrument.
    const wxFileName path(wxFileName(wxStandardPaths::Get().GetExecutablePath()).GetPath(),
                          "libvaro.so");
    m_handle = dlopen(path.GetFullPath().fn_str(), RTLD_NOW | RTLD_LOCAL);
    EXPECT_NE(m_handle, nullptr) << "no simulator at " << path.GetFullPath();
    if (m_handle == nullptr)
        return;
    Resolve(m_setState, "varosim_set_state");
    Resolve(m_setMeasureResult, "varosim_set_measure_result");
    Resolve(m_setMeasureDelay, "varosim_set_measure_delay");
    Resolve(m_fire, "varosim_fire");
    Resolve(m_waitIdle, "varosim_wait_idle");
    Resolve(m_calls, "varosim_calls");
    Resolve(m_optionLog, "varosim_option_log");
}

VaroSimControl::~VaroSimControl()
{
    if (m_handle != nullptr)
        dlclose(m_handle);
}

template <typename Function> void VaroSimControl::Resolve(Function& function, const char* name)
{
    function = reinterpret_cast<Function>(dlsym(m_handle, name));
    ASSERT_NE(function, nullptr) << name;
}

std::string VaroSimControl::OptionLog() const
{
    std::string log(m_optionLog(nullptr, 0) + 1, '\0');
    log.resize(m_optionLog(&log[0], log.size()));
    return log;
}
