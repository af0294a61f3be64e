// Whether the display has an input seat. A Wayland compositor may have none (a
// headless or kiosk one); GTK's message boxes and its clipboard look the seat up and
// crash without one, and no one could answer a message there anyway.
#pragma once

bool HasInputSeat();
