#include "platform/ResourceIcon.h"

#include <windows.h>

// Made at the size the group gives: CreateIconFromResource itself would scale
// every image to the system's default icon size.
std::optional<wxIcon> SystemIconFromResource(const unsigned char* data, std::size_t size, int width,
                                             int height)
{
    wxIcon icon;
    const HICON handle = CreateIconFromResourceEx(const_cast<PBYTE>(data), DWORD(size), TRUE,
                                                  0x00030000, width, height, LR_DEFAULTCOLOR);
    if (handle && !icon.CreateFromHICON(handle))
        DestroyIcon(handle);
    return icon;
}
