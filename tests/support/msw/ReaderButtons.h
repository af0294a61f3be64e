// What a screen reader learns of a window's push buttons through MSAA, asked from the
// test's process: for a window of another process the answers come from there.
#pragma once
#include <windows.h>

#include <oleacc.h>

#include <string>
#include <vector>

struct ReaderButton
{
    std::string name;
    std::string defaultAction;
    IAccessible* accessible; // released by the caller
};

// The push buttons among the child windows of `frame`.
std::vector<ReaderButton> ReaderButtons(HWND frame);
