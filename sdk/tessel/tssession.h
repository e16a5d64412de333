// The session as a whole: whether it is about to end, and where it waits for the person in front of it.
//
// For whoever runs a loop of their own that waits for a person; the dialogs' windows do what is said here by
// themselves.
#pragma once

#include "tsdefs.h"

// A descriptor that can be read from as soon as the session is to end: the person has left it, or the system
// asks the program to end. -1 outside of a session. A loop waits for it, too, begins nothing new once it can
// be read from, and returns soon. It is the host's: nobody reads from it or closes it.
TESSEL_API int tsrxEndRequest();

// Called before each wait for the person. What was written to the registry since the last call, or since the
// command began, is stored now, so that no other session has to wait for somebody who has gone away.
//
// `actionIsOver`: when something could not be stored, one sentence says so, and what is written from now on
// is tried again. Otherwise the wait is a question in the midst of an action, and a failure lasts: what is
// left of the action is not stored without what it belongs to.
TESSEL_API void tsrxBeforeWaiting(bool actionIsOver);

// Whether another session works with the same profile now. What it has read before stays in its memory: it
// does not learn of what is stored here. False outside of a session, and where the host cannot tell.
TESSEL_API bool tsrxOtherSessionRuns();
