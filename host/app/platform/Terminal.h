// The terminal of the desktop.
#pragma once

#include <filesystem>

#include "host/platform/Programs.h"

namespace tessel
{
// What opens a window of it with the program running in it. None: desktops do it for programs that ask for
// it.
ProgramWords programInTerminal(const std::filesystem::path& program);
} // namespace tessel
