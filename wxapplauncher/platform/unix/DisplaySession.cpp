#include "platform/DisplaySession.h"

#include <gdk/gdk.h>
#include <gdk/gdkx.h>

void PrepareToolkit(const char* programName)
{
    // The desktop entry's name: the Wayland app_id and the X11 instance name (its class
    // stays the application's name, the entry's StartupWMClass).
    g_set_prgname(programName);
    // The frame's fixed size and the Verify raise need X11, so on a Wayland session the
    // launcher runs through XWayland when it can. This process only: the modules inherit no
    // GDK_BACKEND, and a user's GDK_BACKEND still wins.
    gdk_set_allowed_backends("x11,*");
}

bool HasInputSeat()
{
    // GTK's message box first releases the pointer, which GDK then looks up on the
    // missing seat and crashes.
    GdkDisplay* display = gdk_display_get_default();
    return display && gdk_display_get_default_seat(display);
}

bool AreDecorationsOutsideSize()
{
    // On X11 (XWayland included) the window manager draws them; on Wayland GTK draws
    // them itself and counts them in the size.
    GdkDisplay* display = gdk_display_get_default();
    return display && GDK_IS_X11_DISPLAY(display);
}
