// The order of the Startup Suite, which is the order of loading.
#pragma once

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
// Moves the entry of the path to the other side of its neighbour's: before it, if it came after it, and the
// other way round. Answers false, with nothing changed, when they are not both in the Suite.
[[nodiscard]] bool MoveInStartupSuite(const CStdStr& path, const CStdStr& neighbour);
} // namespace ModrigUtils
