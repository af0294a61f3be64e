#include "platform/WindowActivation.h"

#include <wx/string.h>

#include <windows.h>

bool BringWindowToFront(const char* windowClass, const char* title)
{
    const HWND window =
        FindWindowW(wxString::FromUTF8(windowClass).wc_str(), wxString::FromUTF8(title).wc_str());
    if (!window)
        return false;
    // A minimised window would only come to the front of the task bar.
    if (IsIconic(window))
        ShowWindowAsync(window, SW_RESTORE);
    BringWindowToTop(window);
    SetForegroundWindow(window);
    SetFocus(window);
    return true;
}
