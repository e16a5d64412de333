// Where a table takes the rows that join it.
#pragma once

#include <cstddef>

namespace ModrigUtils
{
inline constexpr int kAppendRow = -1;

// The place of a new row in a table: before the row where files were dropped, or at the end. A table with
// fewer rows takes it at its end.
[[nodiscard]] std::size_t RowForInsertion(int insertRow, std::size_t rows);
} // namespace ModrigUtils
