// The end of the session, while windows wait for a person: they close as if their close buttons had been
// pressed, so that whoever opened them stores what is to be stored and returns.
#pragma once

namespace tessel
{
// Called once, when the application object is there.
void closeWindowsWhenTheSessionEnds();

// Cancels the window that a person is in front of, and an open menu before it. Called again and again until
// what is to be closed has gone: windows lie over one another.
void cancelFrontWindow();

// Whether the session is to end: nothing should be asked any more.
bool sessionIsToEnd();
} // namespace tessel
