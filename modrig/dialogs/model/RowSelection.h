// Which rows of a table are selected, whoever selects them.
#pragma once

#include <cstddef>
#include <functional>
#include <vector>

#include "modrig/dialogs/model/TableActions.h"

namespace ModrigUtils
{
// A question about a row that is there.
using RowTest = std::function<bool(std::size_t row)>;

// Whether the row may be selected. All that can be done with a loaded application is to unload it, so in that
// table only those may be that can be unloaded, and no place without a row. Other tables refuse nothing.
[[nodiscard]] bool MayBeSelected(TableKind kind, long row, std::size_t rows, const RowTest& isUnloadable);

// Those of the rows that may be selected, in their order: what stays of a selection that somebody else made.
[[nodiscard]] std::vector<std::size_t> SelectableOf(const std::vector<std::size_t>& rows,
                                                    const RowTest& mayBeSelected);

// Every row of the table that may be selected.
[[nodiscard]] std::vector<std::size_t> AllSelectable(std::size_t rows, const RowTest& mayBeSelected);

// The rows that a menu is for.
enum class MenuRows
{
    kNone,          // it was opened beside the rows
    kSelection,     // the row is selected, and the menu is for all that are
    kNewSelection,  // the click selects the row first
    kUnselectedRow, // the row cannot be selected, and nothing changes
};

// `row`: where the menu was opened, negative beside the rows.
[[nodiscard]] MenuRows RowsOfMenu(long row, bool isSelected, bool mayBeSelected);
} // namespace ModrigUtils
