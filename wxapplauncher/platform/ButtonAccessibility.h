// What screen readers see of a window that draws an image button: a push
// button named by its label, with a "click" action; without a label it is a
// picture.
#pragma once

#include <wx/string.h>

#include <functional>

class wxWindow;

// What the accessibility layer asks of the button, each time it is asked, on
// the GUI thread.
struct ButtonAccessibility
{
    std::function<bool()> isLabelled; // false: a picture, answered as before
    std::function<wxString()> name;   // the label as it is read out
    std::function<void()> click;      // the button's action
};

// Makes `window` answer as a push button while it is labelled: its name, the
// role push button, focusable, and the action "click", which runs `click`
// after the answer and only while the window is enabled. `ForgetButton`
// before the window goes.
void ExposeAsButton(wxWindow* window, ButtonAccessibility button);
void ForgetButton(wxWindow* window);
