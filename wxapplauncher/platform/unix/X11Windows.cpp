#include "platform/WindowActivation.h"

#include <gdk/gdk.h>
#include <gdk/gdkx.h>

#include <X11/Xatom.h>
#include <X11/Xlib.h>
#include <X11/Xutil.h>

#include <cstring>
#include <string>

namespace {

// Client windows sit at most a few levels below the root: window managers
// wrap them in frames of their own.
constexpr int kSearchDepth = 3;

std::string WindowTitle(Display* display, Window window)
{
    const Atom netWmName = XInternAtom(display, "_NET_WM_NAME", False);
    const Atom utf8 = XInternAtom(display, "UTF8_STRING", False);
    Atom type = None;
    int format = 0;
    unsigned long count = 0, remaining = 0;
    unsigned char* data = nullptr;
    std::string title;
    if (XGetWindowProperty(display, window, netWmName, 0, 1024, False, utf8, &type, &format, &count,
                           &remaining, &data) == Success &&
        data && type == utf8 && format == 8) {
        title.assign(reinterpret_cast<char*>(data), count);
        XFree(data);
        return title;
    }
    if (data)
        XFree(data);

    char* name = nullptr;
    if (XFetchName(display, window, &name) && name) {
        title = name;
        XFree(name);
    }
    return title;
}

bool Matches(Display* display, Window window, const char* windowClass, const char* title)
{
    XClassHint hint = {};
    if (!XGetClassHint(display, window, &hint))
        return false;
    const bool classMatches = hint.res_class && std::strcmp(hint.res_class, windowClass) == 0;
    if (hint.res_name)
        XFree(hint.res_name);
    if (hint.res_class)
        XFree(hint.res_class);
    return classMatches && WindowTitle(display, window) == title;
}

Window FindWindow(Display* display, Window parent, const char* windowClass, const char* title,
                  int depth)
{
    Window root = 0, parentOut = 0;
    Window* children = nullptr;
    unsigned int count = 0;
    if (!XQueryTree(display, parent, &root, &parentOut, &children, &count))
        return 0;
    Window found = 0;
    for (unsigned int i = count; i-- > 0 && !found;) {
        if (Matches(display, children[i], windowClass, title))
            found = children[i];
        else if (depth > 1)
            found = FindWindow(display, children[i], windowClass, title, depth - 1);
    }
    if (children)
        XFree(children);
    return found;
}

void RequestActivation(Display* display, Window window)
{
    XEvent event = {};
    event.xclient.type = ClientMessage;
    event.xclient.window = window;
    event.xclient.message_type = XInternAtom(display, "_NET_ACTIVE_WINDOW", False);
    event.xclient.format = 32;
    event.xclient.data.l[0] = 2; // a pager-like request: window managers honour it
    event.xclient.data.l[1] = CurrentTime;
    XSendEvent(display, DefaultRootWindow(display), False,
               SubstructureRedirectMask | SubstructureNotifyMask, &event);
}

// Every X error on a connection of our own is the window vanishing meanwhile.
int IgnoreError(Display*, XErrorEvent*)
{
    return 0;
}

bool Activate(Display* display, const char* windowClass, const char* title)
{
    const Window window =
        FindWindow(display, DefaultRootWindow(display), windowClass, title, kSearchDepth);
    if (window) {
        XRaiseWindow(display, window);
        RequestActivation(display, window);
        XSetInputFocus(display, window, RevertToParent, CurrentTime);
    }
    XSync(display, False);
    return window != 0;
}

} // namespace

bool BringWindowToFront(const char* windowClass, const char* title)
{
    GdkDisplay* gdkDisplay = gdk_display_get_default();
    if (gdkDisplay && GDK_IS_X11_DISPLAY(gdkDisplay)) {
        // The window belongs to another program and may vanish at any moment.
        gdk_x11_display_error_trap_push(gdkDisplay);
        const bool found = Activate(GDK_DISPLAY_XDISPLAY(gdkDisplay), windowClass, title);
        gdk_x11_display_error_trap_pop_ignored(gdkDisplay);
        return found;
    }
    // The launcher on Wayland itself: X11 modules still live on XWayland's DISPLAY.
    Display* display = XOpenDisplay(nullptr);
    if (!display)
        return false;
    const XErrorHandler previous = XSetErrorHandler(IgnoreError);
    const bool found = Activate(display, windowClass, title);
    XSetErrorHandler(previous);
    XCloseDisplay(display);
    return found;
}
