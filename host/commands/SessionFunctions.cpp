// The functions of the SDK that concern the session: its wait for the person, and its end.
#include <tessel/tssession.h>

#include "host/commands/EndRequest.h"
#include "host/commands/RunningMarker.h"
#include "host/registry/LayeredRegistry.h"
#include "host/text/CommandLine.h"
#include "host/text/Running.h"

using tessel::running;

namespace
{
void tellOf(const tessel::Result<>& stored)
{
    if (auto* commandLine = running<tessel::CommandLine>())
        commandLine->tell(stored);
}
} // namespace

int tsrxEndRequest()
{
    const auto* request = running<tessel::EndRequest>();
    return request ? request->descriptor() : -1;
}

void tsrxBeforeWaiting(bool actionIsOver)
{
    if (auto* marker = running<tessel::RunningMarker>())
        marker->noteWaiting();
    auto* registry = running<tessel::LayeredRegistry>();
    if (!registry)
        return;
    if (actionIsOver)
        tellOf(registry->endOfCommand());
    else
        registry->own().storeSoFar();
}

bool tsrxOtherSessionRuns()
{
    const auto* marker = running<tessel::RunningMarker>();
    return marker && marker->otherSessionRuns();
}
