#include "modrig/dialogs/model/RowSelection.h"

#include <algorithm>
#include <iterator>

namespace ModrigUtils
{
bool MayBeSelected(TableKind kind, long row, std::size_t rows, const RowTest& isUnloadable)
{
    if (kind != TableKind::kLoadedApplications)
        return true;
    return row >= 0 && static_cast<std::size_t>(row) < rows && isUnloadable(static_cast<std::size_t>(row));
}

std::vector<std::size_t> SelectableOf(const std::vector<std::size_t>& rows, const RowTest& mayBeSelected)
{
    std::vector<std::size_t> selectable;
    std::copy_if(rows.begin(), rows.end(), std::back_inserter(selectable), mayBeSelected);
    return selectable;
}

std::vector<std::size_t> AllSelectable(std::size_t rows, const RowTest& mayBeSelected)
{
    std::vector<std::size_t> selectable;
    for (std::size_t row = 0; row < rows; ++row)
        if (mayBeSelected(row))
            selectable.push_back(row);
    return selectable;
}

MenuRows RowsOfMenu(long row, bool isSelected, bool mayBeSelected)
{
    if (row < 0)
        return MenuRows::kNone;
    if (isSelected)
        return MenuRows::kSelection;
    return mayBeSelected ? MenuRows::kNewSelection : MenuRows::kUnselectedRow;
}
} // namespace ModrigUtils
