// Opening a file without following links.
#pragma once

#include <string>

#include "host/platform/Descriptor.h"

namespace tessel
{
// The file that stands at the path, with the flags of `open`; nothing when the path leads there through a
// symbolic link or by other letters, when the file cannot be opened, or on a system that is too old to be
// asked this way.
Descriptor openDirectly(const std::string& path, int flags);
} // namespace tessel
