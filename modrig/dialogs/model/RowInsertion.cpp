#include "modrig/dialogs/model/RowInsertion.h"

#include <algorithm>

namespace ModrigUtils
{
std::size_t RowForInsertion(int insertRow, std::size_t rows)
{
    return insertRow < 0 ? rows : std::min(static_cast<std::size_t>(insertRow), rows);
}
} // namespace ModrigUtils
