#include "platform/DesktopOpen.h"

#include <wx/app.h>

#include <windows.h>

#include <shellapi.h>

// The shell opens documents with the program registered for their type and
// addresses with the user's browser.
void OpenWithDesktop(const wxString& target, std::function<void()> onFailure)
{
    const HINSTANCE result = ShellExecuteW(GetDesktopWindow(), L"open", target.wc_str(), nullptr,
                                           nullptr, SW_SHOWNORMAL);
    if (reinterpret_cast<INT_PTR>(result) > 32 || !onFailure)
        return;
    // Reported once the caller's handler is done, as where the opener reports later.
    if (wxTheApp)
        wxTheApp->CallAfter(onFailure);
    else
        onFailure();
}
