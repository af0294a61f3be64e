#include "support/X11Client.h"

#include <X11/Xlib.h>

#include <X11/Xatom.h>
#include <X11/Xutil.h>

namespace {

std::string Title(Display* display, Window window)
{
    Atom type = None;
    int format = 0;
    unsigned long count = 0, remaining = 0;
    unsigned char* data = nullptr;
    const Atom netWmName = XInternAtom(display, "_NET_WM_NAME", False);
    const Atom utf8 = XInternAtom(display, "UTF8_STRING", False);
    std::string title;
    if (XGetWindowProperty(display, window, netWmName, 0, 1024, False, utf8, &type, &format, &count,
                           &remaining, &data) == Success &&
        data && format == 8)
        title.assign(reinterpret_cast<char*>(data), count);
    if (data)
        XFree(data);
    if (title.empty()) {
        char* name = nullptr;
        if (XFetchName(display, window, &name) && name) {
            title = name;
            XFree(name);
        }
    }
    return title;
}

Window Search(Display* display, Window parent, const std::string& title, int depth)
{
    Window root = 0, up = 0;
    Window* children = nullptr;
    unsigned int count = 0;
    if (!XQueryTree(display, parent, &root, &up, &children, &count))
        return 0;
    Window found = 0;
    for (unsigned int i = 0; i < count && !found; ++i) {
        XWindowAttributes attributes;
        if (Title(display, children[i]) == title &&
            XGetWindowAttributes(display, children[i], &attributes) &&
            attributes.map_state == IsViewable)
            found = children[i];
        else if (depth > 1)
            found = Search(display, children[i], title, depth - 1);
    }
    if (children)
        XFree(children);
    return found;
}

int IgnoreErrors(Display*, XErrorEvent*)
{
    return 0;
}

XErrorHandler g_previousHandler = nullptr;

} // namespace

X11Client::X11Client(const std::string& display)
    : m_display(XOpenDisplay(display.empty() ? nullptr : display.c_str()))
{
    // Windows of other processes may vanish while they are looked at.
    g_previousHandler = XSetErrorHandler(IgnoreErrors);
}

X11Client::~X11Client()
{
    if (m_display)
        XCloseDisplay(m_display);
    XSetErrorHandler(g_previousHandler);
}

XWindowId X11Client::FindByTitle(const std::string& title)
{
    return m_display ? Search(m_display, DefaultRootWindow(m_display), title, 3) : 0;
}

XWindowId X11Client::ActiveWindow()
{
    if (!m_display)
        return 0;
    Atom type = None;
    int format = 0;
    unsigned long count = 0, remaining = 0;
    unsigned char* data = nullptr;
    Window active = 0;
    if (XGetWindowProperty(m_display, DefaultRootWindow(m_display),
                           XInternAtom(m_display, "_NET_ACTIVE_WINDOW", False), 0, 1, False,
                           XA_WINDOW, &type, &format, &count, &remaining, &data) == Success &&
        data && count == 1)
        active = *reinterpret_cast<Window*>(data);
    if (data)
        XFree(data);
    return active;
}

void X11Client::RequestClose(XWindowId window)
{
    XEvent event = {};
    event.xclient.type = ClientMessage;
    event.xclient.window = window;
    event.xclient.message_type = XInternAtom(m_display, "WM_PROTOCOLS", False);
    event.xclient.format = 32;
    event.xclient.data.l[0] = XInternAtom(m_display, "WM_DELETE_WINDOW", False);
    event.xclient.data.l[1] = CurrentTime;
    XSendEvent(m_display, window, False, NoEventMask, &event);
    XFlush(m_display);
}
