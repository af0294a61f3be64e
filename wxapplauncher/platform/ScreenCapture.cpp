#include "platform/ScreenCapture.h"

#include <gdk/gdk.h>
#ifdef GDK_WINDOWING_X11
#include <gdk/gdkx.h>
#endif

#include <cstring>

// The toolkit's screen device context reads nothing on GTK 3, so GDK reads the root window.
wxImage CaptureScreen(const wxRect& area)
{
#ifdef GDK_WINDOWING_X11
    GdkDisplay* display = gdk_display_get_default();
    if (!display || !GDK_IS_X11_DISPLAY(display) || area.IsEmpty())
        return wxImage();
    GdkPixbuf* pixbuf = gdk_pixbuf_get_from_window(gdk_get_default_root_window(), area.x, area.y,
                                                   area.width, area.height);
    if (!pixbuf)
        return wxImage();
    wxImage image;
    const int channels = gdk_pixbuf_get_n_channels(pixbuf);
    if (gdk_pixbuf_get_bits_per_sample(pixbuf) == 8 && channels >= 3 &&
        gdk_pixbuf_get_width(pixbuf) == area.width &&
        gdk_pixbuf_get_height(pixbuf) == area.height) {
        image.Create(area.width, area.height, false);
        const guchar* row = gdk_pixbuf_read_pixels(pixbuf);
        const int stride = gdk_pixbuf_get_rowstride(pixbuf);
        unsigned char* out = image.GetData();
        for (int y = 0; y < area.height; ++y, row += stride)
            for (int x = 0; x < area.width; ++x, out += 3)
                std::memcpy(out, row + x * channels, 3);
    }
    g_object_unref(pixbuf);
    return image;
#else
    (void)area;
    return wxImage();
#endif
}
