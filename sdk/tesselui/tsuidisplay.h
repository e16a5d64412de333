// Whether the host can show windows, and getting ready to. An application calls `tsuiPrepareWindows` before
// it makes its first window of a command; everything else of the toolkit works from then on.
#pragma once

#include "../tessel/tsdefs.h"

// Whether there is a display that windows can be shown on.
TESSEL_API bool tsuiHasDisplay();

// Makes the application object of the toolkit, with the host's look, keyboard and file drops from other
// programs; the first call does the work. False without a display: one sentence on the command line has then
// said so.
TESSEL_API bool tsuiPrepareWindows();

// Called when a command has closed its windows: deals with the events that have come until now, and draws
// what is still to be drawn. The host goes back to waiting for the terminal, and a window would otherwise
// stay on the screen.
TESSEL_API void tsuiFinishWindows();
