#include "modrig/dialogs/model/ShownTab.h"

#include "modrig/dialogs/model/RowInsertion.h"

namespace ModrigUtils
{
std::optional<long> TabForKey(wchar_t key)
{
    const long tab = key - L'1';
    return tab >= 0 && tab < kTabs ? std::optional(tab) : std::nullopt;
}

std::optional<TableKind> TableToScroll(unsigned added, int insertRow, long tab)
{
    if (added == 0 || insertRow != kAppendRow)
        return std::nullopt;
    if (tab == kLoadedApplicationsTab)
        return TableKind::kLoadedApplications;
    return tab == kHistoryTab ? std::optional(TableKind::kHistory) : std::nullopt;
}
} // namespace ModrigUtils
