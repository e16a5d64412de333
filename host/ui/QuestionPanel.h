// Questions of applications in a window. The host's library finds these by name, once this one is loaded.
#pragma once

#include <tessel/tsdefs.h>

#include "host/messages/Questions.h"

// Whether a window waits for the person; another can then be opened over it.
extern "C" TESSEL_API bool tsuiHasOpenWindow();

// Asks over that window, until an answer is taken or the person cancels; whether one was taken. Nothing is
// asked when the session is to end.
extern "C" TESSEL_API bool tsuiAskInWindow(const tessel::QuestionWindows::Asked& asked);
