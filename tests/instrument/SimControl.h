// Reaches the control interface of the instrument simulator through the very
// library the client loaded: the libvaro.so beside the test binary.
#pragma once

#include "platform/VaroLibrary.h"
#include "varosim.h"

#include <gtest/gtest.h>

template <typename Function> Function* SimFunction(const char* name)
{
    void* symbol = VaroLibrary::Get().Symbol(name);
    EXPECT_NE(symbol, nullptr) << name << ": no simulator beside the test binary";
    return reinterpret_cast<Function*>(symbol);
}

// Calls a control function by its name: SIM(varosim_fire)(1000, 0).
#define SIM(function) (*SimFunction<decltype(function)>(#function))
