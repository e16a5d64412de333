// Where programs keep data on this platform.
#pragma once

#include <filesystem>
#include <vector>

namespace tessel
{
// A person's own. Empty when the environment does not tell.
std::filesystem::path personalDataHome();

// Tessel's among what administrators lay out for everybody on the machine; later ones stand before earlier.
// The last is the machine's own, which no person's environment takes away.
std::vector<std::filesystem::path> machineFolders();
} // namespace tessel
