#include "platform/ScreenCapture.h"

#include <gdk/gdk.h>

#include <cstdint>
#include <cstring>
#ifdef GDK_WINDOWING_X11
#include <X11/Xlib.h>
#include <X11/Xutil.h>
#include <gdk/gdkx.h>
#endif

namespace {

#ifdef GDK_WINDOWING_X11
int HostByteOrder()
{
    const std::uint16_t one = 1;
    unsigned char first = 0;
    std::memcpy(&first, &one, 1);
    return first ? LSBFirst : MSBFirst;
}

int LowestBit(unsigned long mask)
{
    int shift = 0;
    while (mask && !(mask & 1)) {
        mask >>= 1;
        ++shift;
    }
    return shift;
}
#endif

} // namespace

// The toolkit's screen device context reads nothing on GTK 3, so the root window is read
// directly: one request to the server, with no intermediate surfaces on the way.
wxImage CaptureScreen(const wxRect& logical)
{
#ifdef GDK_WINDOWING_X11
    GdkDisplay* display = gdk_display_get_default();
    if (!display || !GDK_IS_X11_DISPLAY(display) || logical.IsEmpty())
        return wxImage();
    Display* x11 = GDK_DISPLAY_XDISPLAY(display);
    // The server counts physical pixels; a desktop scaled to 200% has two per logical one.
    const int scale = gdk_window_get_scale_factor(gdk_get_default_root_window());
    const wxRect area(logical.GetPosition() * scale, logical.GetSize() * scale);
    // An area reaching off the screen is an X error, not a crash.
    gdk_x11_display_error_trap_push(display);
    XImage* shot = XGetImage(x11, DefaultRootWindow(x11), area.x, area.y, area.width, area.height,
                             AllPlanes, ZPixmap);
    gdk_x11_display_error_trap_pop_ignored(display);
    if (!shot)
        return wxImage();
    wxImage image;
    const unsigned long masks[3] = {shot->red_mask, shot->green_mask, shot->blue_mask};
    // Only 8 bits per channel are taken; other visuals go without the capture.
    bool eightBits = true;
    int shifts[3];
    for (int c = 0; c < 3; ++c) {
        shifts[c] = LowestBit(masks[c]);
        eightBits = eightBits && masks[c] >> shifts[c] == 0xFF;
    }
    if (eightBits && shot->width == area.width && shot->height == area.height) {
        image.Create(area.width, area.height, false);
        unsigned char* out = image.GetData();
        // The usual 32-bit pixels in this machine's byte order are read in place; a call
        // per pixel would cost start-up a millisecond.
        const bool inPlace = shot->bits_per_pixel == 32 && shot->byte_order == HostByteOrder();
        for (int y = 0; y < area.height; ++y) {
            const char* row = shot->data + std::size_t(y) * std::size_t(shot->bytes_per_line);
            for (int x = 0; x < area.width; ++x) {
                std::uint32_t word = 0;
                if (inPlace)
                    std::memcpy(&word, row + std::size_t(x) * 4, 4);
                const unsigned long pixel = inPlace ? word : XGetPixel(shot, x, y);
                for (int c = 0; c < 3; ++c)
                    *out++ = static_cast<unsigned char>((pixel & masks[c]) >> shifts[c]);
            }
        }
    }
    XDestroyImage(shot);
    return image;
#else
    (void)logical;
    return wxImage();
#endif
}
