#include "modrig/dialogs/model/RowInsertion.h"

#include <algorithm>

namespace ModrigUtils
{
std::size_t RowForInsertion(int insertRow, std::size_t rows)
{
    return insertRow < 0 ? rows : std::min(static_cast<std::size_t>(insertRow), rows);
}

std::vector<TableKind> TablesToJoin(bool savesHistory, const std::function<bool(TableKind)>& holds)
{
    std::vector<TableKind> tables;
    if (!holds(TableKind::kLoadedApplications))
        tables.push_back(TableKind::kLoadedApplications);
    if (savesHistory && !holds(TableKind::kHistory))
        tables.push_back(TableKind::kHistory);
    return tables;
}
} // namespace ModrigUtils
