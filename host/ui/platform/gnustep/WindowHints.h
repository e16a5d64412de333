// What the desktop is told about a window (Extended Window Manager Hints, Inter-Client Communication
// Conventions). Windows are numbers of the X display, as the toolkit hands them out, 0 is none; the display
// is the toolkit's own connection.
#pragma once

namespace tessel::windowing
{
// The descriptor that tells when something has come from the display.
int connectionNumber(void* display);

bool isOnScreen(unsigned long window, void* display);

// Before the window is shown: which process it is of and, if it has an owner, that it is a dialog which stays
// over it.
void introduceWindow(unsigned long window, unsigned long owner, void* display);
} // namespace tessel::windowing
