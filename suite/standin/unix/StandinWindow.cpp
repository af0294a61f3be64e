#include "StandinWindow.h"

#include <X11/Xatom.h>
#include <X11/Xlib.h>
#include <X11/Xutil.h>
#include <algorithm>
#include <cstdio>
#include <unistd.h>

namespace standin {

namespace {

void SetTitle(Display* display, Window window, const WindowIdentity& identity,
              const std::string& baseName)
{
    // Xutf8SetWMProperties wants mutable strings and a terminated array.
    std::string name = baseName;
    std::string wmClass = identity.wmClass;
    XClassHint classHint;
    classHint.res_name = name.data();
    classHint.res_class = wmClass.data();
    Xutf8SetWMProperties(display, window, identity.title.c_str(), identity.title.c_str(), nullptr,
                         0, nullptr, nullptr, &classHint);

    Atom utf8 = XInternAtom(display, "UTF8_STRING", False);
    XChangeProperty(display, window, XInternAtom(display, "_NET_WM_NAME", False), utf8, 8,
                    PropModeReplace, reinterpret_cast<const unsigned char*>(identity.title.data()),
                    static_cast<int>(identity.title.size()));
    long pid = getpid();
    XChangeProperty(display, window, XInternAtom(display, "_NET_WM_PID", False), XA_CARDINAL, 32,
                    PropModeReplace, reinterpret_cast<const unsigned char*>(&pid), 1);
}

void WriteReadyFile(const std::string& readyFile, Window window)
{
    std::string temporary = readyFile + ".tmp";
    FILE* file = std::fopen(temporary.c_str(), "w");
    if (!file)
        return;
    bool written = std::fprintf(file, "%lu\n", static_cast<unsigned long>(window)) > 0;
    if (std::fclose(file) == 0 && written)
        std::rename(temporary.c_str(), readyFile.c_str());
    else
        std::remove(temporary.c_str());
}

void Draw(Display* display, Window window, GC gc, const std::vector<std::string>& lines)
{
    XClearWindow(display, window);
    int y = kMargin + kLineHeight;
    for (const std::string& line : lines) {
        XDrawString(display, window, gc, kMargin, y, line.data(), static_cast<int>(line.size()));
        y += kLineHeight;
    }
}

} // namespace

int RunWindow(const std::string& baseName, const std::vector<std::string>& args,
              const std::string& readyFile)
{
    Display* display = XOpenDisplay(nullptr);
    if (!display)
        return 1;

    std::vector<std::string> lines{baseName};
    if (args.empty())
        lines.push_back("(no arguments)");
    for (const std::string& arg : args) {
        if (static_cast<int>(lines.size()) == kMaxLines) {
            lines.push_back("...");
            break;
        }
        lines.push_back("[" + arg + "]");
    }

    int screen = DefaultScreen(display);
    unsigned height = kMargin * 2 + kLineHeight * static_cast<unsigned>(lines.size());
    Window window =
        XCreateSimpleWindow(display, RootWindow(display, screen), 0, 0, kWidth, height, 0,
                            BlackPixel(display, screen), WhitePixel(display, screen));
    SetTitle(display, window, IdentityFor(baseName), baseName);
    Atom deleteWindow = XInternAtom(display, "WM_DELETE_WINDOW", False);
    XSetWMProtocols(display, window, &deleteWindow, 1);
    XSelectInput(display, window, ExposureMask | StructureNotifyMask);
    GC gc = XCreateGC(display, window, 0, nullptr);
    XSetForeground(display, gc, BlackPixel(display, screen));
    XMapWindow(display, window);

    bool ready = false;
    for (;;) {
        XEvent event;
        XNextEvent(display, &event);
        if (event.type == MapNotify && !ready && !readyFile.empty()) {
            ready = true;
            WriteReadyFile(readyFile, window);
        } else if (event.type == Expose && event.xexpose.count == 0) {
            Draw(display, window, gc, lines);
        } else if (event.type == ClientMessage &&
                   static_cast<Atom>(event.xclient.data.l[0]) == deleteWindow) {
            break;
        }
    }
    XFreeGC(display, gc);
    XDestroyWindow(display, window);
    XCloseDisplay(display);
    return 0;
}

} // namespace standin
