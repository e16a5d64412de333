// The network's library, mapped when something is fetched for the first time: it brings some twenty others
// along, which every start would have to wait for.
#pragma once

#include "host/text/Result.h"

namespace tessel
{
class Network;

// It stays to the end of the process. Fails when it cannot be mapped, or is of another version: an update may
// have replaced it since the start. Why is the end of a sentence.
Result<Network*> network();
} // namespace tessel
