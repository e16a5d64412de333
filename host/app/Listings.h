// What the host's listing commands answer to programs: typed with --json as the last argument, each says one
// JSON document. The fields are told in docs/administrators.md, and stay: new ones may join them.
#pragma once

namespace tessel
{
struct Parts;

// To be called when the commands have been added: APPS, HELP, PROFILE, SETVAR. REGISTRY has its own.
void addListings(Parts& parts);
} // namespace tessel
