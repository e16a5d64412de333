// How long a person waits for the window of the MODRIG command.
#pragma once

#include <sys/types.h>

namespace bench
{
// Seconds of processor time, from the command to the moment at which the dialog's window is mapped,
// everything in it is drawn, and the display has carried out all that it was told; then the dialog is closed.
// What the display takes is part of it where its process is known, and 0 is not. Negative when that moment
// does not come.
double secondsUntilShown(pid_t display);

// The same of a window with nothing in it but a table, filled with the module's History as the dialog's is.
double secondsUntilListShown(pid_t display);
} // namespace bench
