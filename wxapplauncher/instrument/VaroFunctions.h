// The six functions of the instrument library, known by ordinal (on Linux the
// library exports them by name):
//   18 VaroRegisterCallback  register the notification callback
//   14 VaroCheckInstrument   0 = an instrument answers
//   23 VaroCheckTableMount   0 = the instrument sits on the measuring table
//   11 VaroSetOption         set an option (name, value)
//   12 VaroGetOption         read an option; the text belongs to the library
//    5 VaroMeasure           measure; 0 = success, else a failure status
#pragma once

extern "C" {
typedef void (*VaroNotifyFunction)(int code, int data);
typedef void (*VaroRegisterCallbackFunction)(VaroNotifyFunction callback);
typedef int (*VaroCheckFunction)();
typedef void (*VaroSetOptionFunction)(const char* name, const char* value);
typedef const char* (*VaroGetOptionFunction)(const char* name);
typedef int (*VaroMeasureFunction)();
}

// The library's functions, resolved all together: when the library or any one
// of them is missing, Get() answers null and the client acts as if no
// instrument were attached.
struct VaroFunctions
{
    VaroRegisterCallbackFunction registerCallback; // 18
    VaroCheckFunction checkInstrument;             // 14
    VaroCheckFunction checkTableMount;             // 23
    VaroSetOptionFunction setOption;               // 11
    VaroGetOptionFunction getOption;               // 12
    VaroMeasureFunction measure;                   // 5

    static const VaroFunctions* Get();
};
