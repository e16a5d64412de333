// Where many paths lead in the end.
#pragma once

#include <functional>

#include "modrig/base/CStdStr.h"

namespace ModrigPlatform
{
// Answers paths with their symbolic links resolved: what the toolkit's stringByResolvingSymlinksInPath makes
// of each. The answer is good until the next call, or while the path is. A resolver is for paths that are
// asked about at one time: it need not notice what becomes of a folder in the meantime.
using LinkResolver = std::function<const CStdStr&(const CStdStr& path)>;

[[nodiscard]] LinkResolver MakeLinkResolver();
} // namespace ModrigPlatform
