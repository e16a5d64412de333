// Where programs keep a person's data on this platform.
#pragma once

#include <filesystem>

namespace tessel
{
// Empty when the environment does not tell.
std::filesystem::path personalDataHome();
} // namespace tessel
