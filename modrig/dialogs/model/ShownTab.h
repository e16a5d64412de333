// Which tab is in sight: what leads to one, and what a load shows there of the rows that it has added.
#pragma once

#include <optional>

#include "modrig/dialogs/model/TableActions.h"

namespace ModrigUtils
{
// The tabs of the Load/Unload dialog.
inline constexpr long kLoadedApplicationsTab = 0;
inline constexpr long kHistoryTab = 1;
inline constexpr long kTabs = 2;

// The tab that the key stands for together with the platform's key for commands: 1 is the first.
[[nodiscard]] std::optional<long> TabForKey(wchar_t key);

// The table that scrolls to its last row: the one in sight, when rows have been added at the end. Rows that
// were added where files were dropped are in sight already.
[[nodiscard]] std::optional<TableKind> TableToScroll(unsigned added, int insertRow, long tab);
} // namespace ModrigUtils
