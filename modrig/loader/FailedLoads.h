// Which applications did not load when that was last tried: a person sees it in the lists for as long as the
// session lasts. Main thread only.
#pragma once

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
// What became of loading the file at the path, whose letters' case does not matter.
void NoteLoad(const CStdStr& path, bool succeeded);

[[nodiscard]] bool LastLoadFailed(const CStdStr& path);
} // namespace ModrigUtils
