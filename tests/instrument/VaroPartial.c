/* An instrument library that lacks its measure function. The client must
 * treat it as no library at all: its answers would mean "on the table", and
 * registering with it ends the process. */
#include <stdlib.h>

#define EXPORT __attribute__((visibility("default")))

EXPORT void VaroRegisterCallback(void (*callback)(int, int))
{
    (void)callback;
    abort();
}

EXPORT int VaroCheckInstrument(void)
{
    return 0;
}

EXPORT int VaroCheckTableMount(void)
{
    return 0;
}

EXPORT void VaroSetOption(const char* name, const char* value)
{
    (void)name;
    (void)value;
}

EXPORT const char* VaroGetOption(const char* name)
{
    (void)name;
    return "";
}
