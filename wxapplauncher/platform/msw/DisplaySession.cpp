#include "platform/DisplaySession.h"

// The manifest declares the launcher's DPI awareness; there is no display
// connection to choose.
void PrepareToolkit(const char*) {}

// An interactive desktop always has someone who can answer a message box.
bool HasInputSeat()
{
    return true;
}

// The toolkit asks the system for the frame's borders when it turns a client
// size into a window size.
bool AreDecorationsOutsideSize()
{
    return true;
}
