// A message box as the screen shows it: the toolkit's real box, found while it is up,
// with its title as the X server holds it and the icon beside its text; then answered
// with OK.
#pragma once

#include <wx/image.h>

#include <functional>
#include <string>

struct ShownMessageBox
{
    bool seen = false;
    std::string title;
    // The themed icon name of the picture beside the text; empty without one.
    std::string icon;
    // What the screen shows where that picture lies.
    wxImage iconPixels;
};

// Runs `action`, which shows one message box now or from a later event.
ShownMessageBox ObserveMessageBox(const std::function<void()>& action);
