// The session as a whole: whether it is about to end.
#pragma once

#include "tsdefs.h"

// A descriptor that can be read from as soon as the session is to end: the person has left it, or the system
// asks the program to end. -1 outside of a session. Whoever runs a loop of their own waits for it, too, does
// not begin anything new when it speaks, and returns soon; the dialogs' windows do so by themselves. It is
// the host's: nobody reads from it or closes it.
TESSEL_API int tsrxEndRequest();
