// The stand-in's window: a plain top-level window that says which program was
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
inline WindowIdentity IdentityFor(const std::string& baseName)
{
    if (baseName == "ZelVerifyStudio.exe")
        return {"TFrm_Main", "Zel Verify Studio"};
    return {"VeltronaStandin", baseName};
}

// The window's text layout, in pixels: one line for the program, one per argument.
constexpr int kMargin = 12;
constexpr int kLineHeight = 16;
constexpr int kWidth = 480;
constexpr int kMaxLines = 40;

// Shows the window and runs until it is closed. readyFile (UTF-8), when not
// empty, receives the window's id in decimal (the X window id, or the HWND)
// once the window is shown. Returns the exit status: 0 when closed, 1 when no
// window could be shown (no display).
int RunWindow(const std::string& baseName, const std::vector<std::string>& args,
              const std::string& readyFile);

} // namespace standin
