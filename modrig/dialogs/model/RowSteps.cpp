#include "modrig/dialogs/model/RowSteps.h"

#include <algorithm>

#include "modrig/dialogs/model/TableActions.h"

namespace ModrigUtils
{
namespace
{
// How far the key goes; 0 for one that does not move.
long StepOf(wchar_t key, const RowPlaces& places)
{
    const auto page = static_cast<long>(places.page);
    const auto all = static_cast<long>(places.rows);
    switch (key)
    {
    case kUpKey:
        return -1;
    case kDownKey:
        return 1;
    case kPageUpKey:
        return -page;
    case kPageDownKey:
        return page;
    case kHomeKey:
        return -all;
    case kEndKey:
        return all;
    default:
        return 0;
    }
}

std::optional<std::size_t> Search(long row, long direction, long rows,
                                  const std::function<bool(std::size_t)>& canBeSelected)
{
    for (; row >= 0 && row < rows; row += direction)
        if (canBeSelected(static_cast<std::size_t>(row)))
            return static_cast<std::size_t>(row);
    return std::nullopt;
}
} // namespace

std::optional<std::size_t> RowForKey(wchar_t key, const RowPlaces& places,
                                     const std::function<bool(std::size_t)>& canBeSelected)
{
    const long step = StepOf(key, places);
    const auto rows = static_cast<long>(places.rows);
    if (step == 0 || rows == 0)
        return std::nullopt;
    // Without a selection the key comes from beyond the end that it goes away from.
    const long from = places.selected ? static_cast<long>(*places.selected) : (step > 0 ? -1 : rows);
    const long goal = std::clamp(from + step, 0L, rows - 1);
    const long direction = step > 0 ? 1 : -1;
    const auto beyond = Search(goal, direction, rows, canBeSelected);
    return beyond ? beyond : Search(goal, -direction, rows, canBeSelected);
}

std::optional<std::size_t> RowPassedOverFor(wchar_t key, const RowPlaces& places,
                                            const std::function<bool(std::size_t)>& canBeSelected)
{
    const auto row = RowForKey(key, places, canBeSelected);
    return row == RowForKey(key, places, [](std::size_t) { return true; }) ? std::nullopt : row;
}
} // namespace ModrigUtils
