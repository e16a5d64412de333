#include "tests/support/recording/RecordingSession.h"

#include <tessel/tssession.h>

#include "tests/support/RecordingHost.h"

int tsrxEndRequest()
{
    return recordingHost().session.endRequest;
}

void tsrxBeforeWaiting(bool actionIsOver)
{
    recordingHost().session.waits.push_back(actionIsOver);
}

bool tsrxOtherSessionRuns()
{
    return recordingHost().session.otherSessionRuns;
}
