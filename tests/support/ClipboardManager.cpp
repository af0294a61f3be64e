#include "support/ClipboardManager.h"

#include <X11/Xatom.h>
#include <X11/Xlib.h>

#include <cerrno>
#include <poll.h>
#include <string>
#include <unistd.h>

namespace {

struct Atoms
{
    explicit Atoms(Display* display)
        : manager(XInternAtom(display, "CLIPBOARD_MANAGER", False)),
          save(XInternAtom(display, "SAVE_TARGETS", False)),
          clipboard(XInternAtom(display, "CLIPBOARD", False)),
          targets(XInternAtom(display, "TARGETS", False)),
          utf8(XInternAtom(display, "UTF8_STRING", False)),
          saved(XInternAtom(display, "VELTRONA_SAVED", False))
    {
    }
    Atom manager, save, clipboard, targets, utf8, saved;
};

void Notify(Display* display, const XSelectionRequestEvent& request, Atom property)
{
    XEvent reply{};
    reply.xselection.type = SelectionNotify;
    reply.xselection.requestor = request.requestor;
    reply.xselection.selection = request.selection;
    reply.xselection.target = request.target;
    reply.xselection.property = property;
    reply.xselection.time = request.time;
    XSendEvent(display, request.requestor, False, NoEventMask, &reply);
}

std::string TakeText(Display* display, Window window, Atom property)
{
    Atom type = None;
    int format = 0;
    unsigned long count = 0, after = 0;
    unsigned char* data = nullptr;
    std::string text;
    if (XGetWindowProperty(display, window, property, 0, 1 << 20, True, AnyPropertyType, &type,
                           &format, &count, &after, &data) == Success &&
        data) {
        if (format == 8)
            text.assign(reinterpret_cast<char*>(data), count);
        XFree(data);
    }
    return text;
}

} // namespace

ClipboardManager::ClipboardManager()
{
    m_display = XOpenDisplay(nullptr);
    if (!m_display || pipe(m_wake) != 0)
        return;
    m_window = XCreateSimpleWindow(m_display, DefaultRootWindow(m_display), 0, 0, 1, 1, 0, 0, 0);
    const Atoms atoms(m_display);
    XSetSelectionOwner(m_display, atoms.manager, m_window, CurrentTime);
    m_running = XGetSelectionOwner(m_display, atoms.manager) == m_window;
    if (m_running)
        m_thread = std::thread(&ClipboardManager::Serve, this);
}

ClipboardManager::~ClipboardManager()
{
    if (m_thread.joinable()) {
        const char stop = 0;
        (void)!write(m_wake[1], &stop, 1);
        m_thread.join();
    }
    for (const int fd : m_wake)
        if (fd >= 0)
            close(fd);
    if (m_display)
        XCloseDisplay(m_display);
}

void ClipboardManager::Serve()
{
    const Atoms atoms(m_display);
    std::string text;
    XSelectionRequestEvent pendingSave{};
    pollfd fds[2] = {{ConnectionNumber(m_display), POLLIN, 0}, {m_wake[0], POLLIN, 0}};
    for (;;) {
        while (XPending(m_display)) {
            XEvent event;
            XNextEvent(m_display, &event);
            if (event.type == SelectionRequest) {
                const XSelectionRequestEvent& request = event.xselectionrequest;
                if (request.selection == atoms.manager && request.target == atoms.save) {
                    // Fetch the text first; the program waits for the answer.
                    pendingSave = request;
                    XConvertSelection(m_display, atoms.clipboard, atoms.utf8, atoms.saved, m_window,
                                      request.time);
                } else if (request.selection == atoms.clipboard &&
                           request.target == atoms.targets) {
                    const Atom offered[] = {atoms.targets, atoms.utf8};
                    XChangeProperty(m_display, request.requestor, request.property, XA_ATOM, 32,
                                    PropModeReplace,
                                    reinterpret_cast<const unsigned char*>(offered), 2);
                    Notify(m_display, request, request.property);
                } else if (request.selection == atoms.clipboard && request.target == atoms.utf8) {
                    XChangeProperty(m_display, request.requestor, request.property, atoms.utf8, 8,
                                    PropModeReplace,
                                    reinterpret_cast<const unsigned char*>(text.data()),
                                    int(text.size()));
                    Notify(m_display, request, request.property);
                } else {
                    Notify(m_display, request, None);
                }
            } else if (event.type == SelectionNotify && pendingSave.requestor) {
                if (event.xselection.property != None) {
                    text = TakeText(m_display, m_window, event.xselection.property);
                    XSetSelectionOwner(m_display, atoms.clipboard, m_window, CurrentTime);
                }
                Notify(m_display, pendingSave,
                       pendingSave.property != None ? pendingSave.property : pendingSave.target);
                pendingSave = {};
            }
        }
        XFlush(m_display);
        if ((poll(fds, 2, -1) < 0 && errno != EINTR) || fds[1].revents)
            return;
    }
}
