// The network's library, mapped when something is fetched for the first time: it brings some twenty others
// along, which every start would have to wait for.
#pragma once

namespace tessel
{
class Network;

// Null when it cannot be mapped. It stays to the end of the process.
Network* network();
} // namespace tessel
