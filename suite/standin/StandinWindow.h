// The stand-in's window: a plain X11 top-level that says which program was
// started and with which arguments, and looks like the real module to anyone
// searching for it by class and title.
#pragma once

#include <string>
#include <vector>

namespace standin {

struct WindowIdentity
{
    std::string wmClass;
    std::string title;
};

// What the window calls itself for a program of the given base name.
WindowIdentity IdentityFor(const std::string& baseName);

// Shows the window and runs until it is closed. readyFile, when not empty,
// receives the window id once the window is mapped. Returns the exit status:
// 0 when closed, 1 when there is no display.
int RunWindow(const std::string& baseName, const std::vector<std::string>& args,
              const std::string& readyFile);

} // namespace standin
