// Whether files are kept on this machine.
#pragma once

#include <string>

namespace tessel
{
// Whether the folder lies on another machine, or behind a program that may reach one. False when the system
// does not say.
bool isOnNetwork(const std::string& folder);
} // namespace tessel
