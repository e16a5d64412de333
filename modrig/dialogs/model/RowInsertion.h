// Which rows join a table, and where it takes them.
#pragma once

#include <cstddef>
#include <functional>
#include <vector>

#include "modrig/dialogs/model/TableActions.h"

namespace ModrigUtils
{
inline constexpr int kAppendRow = -1;

// The place of a new row in a table: before the row where files were dropped, or at the end. A table with
// fewer rows takes it at its end.
[[nodiscard]] std::size_t RowForInsertion(int insertRow, std::size_t rows);

// The tables that a file which was just loaded joins, in the order in which they take its row: the loaded
// applications, and the History while files are saved there. `holds`: whether the table has a row for that
// file.
//
// Tables go by files, and the lists behind them by applications (`HoldsApplication`). So an object-database
// module joins the table, and not the list, when the History has one of the same name from another folder:
// the row shows what was loaded now, and the next dialog the entry of the list, which stands for both.
[[nodiscard]] std::vector<TableKind> TablesToJoin(bool savesHistory,
                                                  const std::function<bool(TableKind)>& holds);
} // namespace ModrigUtils
