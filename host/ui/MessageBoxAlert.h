// The host's message box as a window. The host's library loads this one when it first shows a box.
#pragma once

#include <tessel/tsdefs.h>

// Shows the box, with the detail below the text unless it is empty, and answers the button's code, or 0 when
// it was not shown: there is no display, or nobody to answer (a script runs and no window of the host is
// open).
extern "C" TESSEL_API int tsuiShowMessageBox(const wchar_t* text, const wchar_t* detail, unsigned style,
                                             void* parent);

// Somebody looks at the display, though there is no terminal to tell so: from now on boxes are shown there.
extern "C" TESSEL_API void tsuiExpectSomebody();

// `tsuiHasDisplay`, by a name that the host's library finds without linking to this one.
extern "C" TESSEL_API bool tsuiCanShowWindows();
