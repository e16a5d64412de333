// What a load shows of the rows that it has added.
#pragma once

#include <optional>

#include "modrig/dialogs/model/TableActions.h"

namespace ModrigUtils
{
// The tabs of the Load/Unload dialog.
inline constexpr long kLoadedApplicationsTab = 0;
inline constexpr long kHistoryTab = 1;

// The table that scrolls to its last row: the one in sight, when rows have been added at the end. Rows that
// were added where files were dropped are in sight already.
std::optional<TableKind> TableToScroll(unsigned added, int insertRow, long tab);
} // namespace ModrigUtils
