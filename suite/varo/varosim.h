// The instrument simulator: the six functions of the instrument library, plus
// a small control interface through which tests and the demo set what the
// simulated instrument answers and make it send notifications.
#pragma once

#include <stddef.h>

#ifdef __cplusplus
extern "C" {
#endif

#ifdef _WIN32
#define VARO_EXPORT // Varo.def names what the DLL exports
#else
#define VARO_EXPORT __attribute__((visibility("default")))
#endif

typedef void (*VaroNotifyCallback)(int code, int data);

// The library's own interface.
VARO_EXPORT void VaroRegisterCallback(VaroNotifyCallback callback);
VARO_EXPORT int VaroCheckInstrument(void);
VARO_EXPORT int VaroCheckTableMount(void);
VARO_EXPORT void VaroSetOption(const char* name, const char* value);
VARO_EXPORT const char* VaroGetOption(const char* name);
VARO_EXPORT int VaroMeasure(void);

// Where the simulated instrument is. The initial state comes from the
// environment variable VARO_SIM_STATE ("none", "direct" or "table"; default none).
enum
{
    VAROSIM_NONE = 0,
    VAROSIM_DIRECT = 1,
    VAROSIM_TABLE = 2
};
VARO_EXPORT void varosim_set_state(int state);

// What VaroMeasure returns, and how long a measurement takes.
VARO_EXPORT void varosim_set_measure_result(int result);
VARO_EXPORT void varosim_set_measure_delay(int milliseconds);

// Queues a notification; the simulator's own thread hands it to the
// registered callback, as the vendor's library does.
VARO_EXPORT void varosim_fire(int code, int data);

// Waits until every queued notification has been handed over and the callback
// has returned. Returns 0 when idle, -1 when the deadline passed first.
VARO_EXPORT int varosim_wait_idle(int timeoutMilliseconds);

// How often one of the six functions was called, by its exported name.
VARO_EXPORT int varosim_calls(const char* function);

// The VaroSetOption calls so far, as "name=value" lines in call order. Copies
// at most size - 1 bytes and a terminating zero; returns the full length.
VARO_EXPORT size_t varosim_option_log(char* buffer, size_t size);

#ifdef __cplusplus
}
#endif
