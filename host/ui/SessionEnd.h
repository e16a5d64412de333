// The end of the session, while windows wait for a person: they close as if their close buttons had been
// pressed, so that whoever opened them stores what is to be stored and returns.
#pragma once

namespace tessel
{
// Called once, when the application object is there.
void closeWindowsWhenTheSessionEnds();

// Whether the session is to end: nothing should be asked any more.
bool sessionIsToEnd();
} // namespace tessel
