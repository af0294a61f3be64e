#include "platform/InputSeat.h"

#include <gdk/gdk.h>

bool HasInputSeat()
{
    GdkDisplay* display = gdk_display_get_default();
    return display && gdk_display_get_default_seat(display);
}
