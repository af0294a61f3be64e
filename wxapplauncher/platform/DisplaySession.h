// The display the launcher runs on: how the toolkit is to connect to it,
// whether anyone there can answer a message box, and who draws the frame's
// decorations.
#pragma once

// Before the toolkit starts: gives the program the desktop's name for it
// (`programName`, as in its desktop entry) and the display connection to
// prefer. Only this process is affected, never the programs it starts.
void PrepareToolkit(const char* programName);

// False when the display has no input devices at all (a headless or kiosk
// compositor): no one could answer a message box there, and showing one may
// not even be safe.
bool HasInputSeat();

// True when the decorations lie outside a window's size, as the toolkit
// assumes when it fixes a size; false where the toolkit draws them itself
// and counts them in the size.
bool AreDecorationsOutsideSize();
