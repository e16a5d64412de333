// The session: whether it is about to end, and where it waits for the person.
#pragma once

#include <vector>

struct RecordingSession
{
    int endRequest = -1; // tsrxEndRequest; the descriptor stays the caller's
    bool otherSessionRuns = false;
    std::vector<bool> waits; // the calls of tsrxBeforeWaiting, and whether an action was over
};
