// What the tip of the Unload button says: what it does, or why it cannot be pressed.
#pragma once

#include <vector>

#include "modrig/dialogs/model/RowLook.h"

namespace ModrigUtils
{
// The keys of its lines. `rows`: the states of all rows in the list of loaded applications.
[[nodiscard]] std::vector<const char*> UnloadTip(bool someAreSelected, const std::vector<RowState>& rows);
} // namespace ModrigUtils
