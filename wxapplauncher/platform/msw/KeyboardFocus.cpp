#include "platform/KeyboardFocus.h"

#include <wx/window.h>

#include <windows.h>

// Windows gives a window no input method unless it asks for one.
void DropInputMethod(wxWindow*) {}

// The rule the system's own buttons follow: the focus rectangle shows unless
// the window's keyboard cues are hidden, which Windows undoes at the first key
// used for moving around.
bool IsFocusShown(const wxWindow* window)
{
    const LRESULT state = SendMessageW(window->GetHWND(), WM_QUERYUISTATE, 0, 0);
    return (state & UISF_HIDEFOCUS) == 0;
}
