// Keeping the applications of selected rows out at starts, and letting them in again.
#pragma once

#include <vector>

#include "modrig/base/CStdStr.h"
#include "modrig/dialogs/model/TableActions.h"

namespace ModrigUtils
{
// What the menu of these applications offers: to let them in when one of them is kept out, else to keep them
// out; `kNone` in a host that knows neither.
[[nodiscard]] TableAction KeepingOutActionFor(const std::vector<CStdStr>& paths);

void KeepAllOut(const std::vector<CStdStr>& paths);

// Lets in those of them that are kept out.
void LetAllIn(const std::vector<CStdStr>& paths);
} // namespace ModrigUtils
