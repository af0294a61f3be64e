#include "support/DesktopTools.h"

#include <wx/image.h>

#include <X11/Xlib.h>
#include <X11/Xutil.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>

namespace {

std::string Capture(const std::string& command)
{
    std::string out;
    if (FILE* pipe = popen(command.c_str(), "r")) {
        char buffer[256];
        while (fgets(buffer, sizeof buffer, pipe))
            out += buffer;
        pclose(pipe);
    }
    return out;
}

} // namespace

unsigned long ActiveWindow()
{
    // "_NET_ACTIVE_WINDOW: window id # 0x400007"
    const std::string line = Capture("xprop -root -notype _NET_ACTIVE_WINDOW 2>/dev/null");
    const size_t hash = line.find("# ");
    return hash == std::string::npos ? 0 : std::strtoul(line.c_str() + hash + 2, nullptr, 16);
}

unsigned long WindowOf(pid_t pid, const std::string& title)
{
    return std::strtoul(Capture("xdotool search --all --onlyvisible --pid " + std::to_string(pid) +
                                " --name '^" + title + "$' 2>/dev/null")
                            .c_str(),
                        nullptr, 10);
}

std::string WindowTitle(unsigned long window)
{
    std::string title;
    if (Display* display = XOpenDisplay(nullptr)) {
        XTextProperty name{};
        const Atom utf8Name = XInternAtom(display, "_NET_WM_NAME", False);
        if ((XGetTextProperty(display, window, &name, utf8Name) && name.value) ||
            (XGetWMName(display, window, &name) && name.value)) {
            title.assign(reinterpret_cast<char*>(name.value), name.nitems);
            XFree(name.value);
        }
        XCloseDisplay(display);
    }
    return title;
}

std::string ClipboardText()
{
    return Capture("timeout 10 xclip -o -selection clipboard -t UTF8_STRING 2>/dev/null");
}

void CloseWindow(unsigned long window)
{
    std::system(("wmctrl -i -c " + std::to_string(window)).c_str());
}

wxImage ScreenPixels(const wxRect& rect, const std::string& displayName)
{
    wxImage pixels(rect.width, rect.height);
    Display* display = XOpenDisplay(displayName.empty() ? nullptr : displayName.c_str());
    if (!display)
        return pixels;
    XImage* image = XGetImage(display, DefaultRootWindow(display), rect.x, rect.y, rect.width,
                              rect.height, AllPlanes, ZPixmap);
    if (image) {
        auto channel = [](unsigned long pixel, unsigned long mask) {
            return static_cast<unsigned char>((pixel & mask) * 255 / mask);
        };
        for (int y = 0; y < rect.height; ++y)
            for (int x = 0; x < rect.width; ++x) {
                const unsigned long p = XGetPixel(image, x, y);
                pixels.SetRGB(x, y, channel(p, image->red_mask), channel(p, image->green_mask),
                              channel(p, image->blue_mask));
            }
        XDestroyImage(image);
    }
    XCloseDisplay(display);
    return pixels;
}

bool SamePixels(const wxImage& a, const wxImage& b, int tolerance)
{
    return a.GetSize() == b.GetSize() &&
           std::equal(a.GetData(), a.GetData() + 3L * a.GetWidth() * a.GetHeight(), b.GetData(),
                      [tolerance](int x, int y) { return std::abs(x - y) <= tolerance; });
}

void MinimiseWindow(unsigned long window)
{
    std::system(("xdotool windowminimize " + std::to_string(window)).c_str());
}

bool IsMinimised(unsigned long window)
{
    return Capture("xprop -id " + std::to_string(window) + " WM_STATE 2>/dev/null")
               .find("Iconic") != std::string::npos;
}

wxRect WindowRect(unsigned long window)
{
    wxRect rect;
    if (Display* display = XOpenDisplay(nullptr)) {
        XWindowAttributes attributes;
        Window child;
        if (XGetWindowAttributes(display, window, &attributes) &&
            XTranslateCoordinates(display, window, DefaultRootWindow(display), 0, 0, &rect.x,
                                  &rect.y, &child))
            rect.SetSize(wxSize(attributes.width, attributes.height));
        XCloseDisplay(display);
    }
    return rect;
}

void TypeKeys(unsigned long window, const std::string& keys)
{
    std::system(
        ("xdotool windowactivate --sync " + std::to_string(window) + " key --delay 100 " + keys)
            .c_str());
}
