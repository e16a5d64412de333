#include "host/ui/platform/gnustep/filepanel/RowSelection.h"

#include <algorithm>

namespace tessel::filepanel
{
namespace
{
RowSelection rangeTo(std::size_t row, std::size_t anchor)
{
    RowSelection range{{}, anchor, row};
    for (std::size_t index = std::min(row, anchor); index <= std::max(row, anchor); ++index)
        range.rows.insert(index);
    return range;
}

RowSelection toggled(const RowSelection& before, std::size_t row)
{
    RowSelection after{before.rows, row, row};
    if (after.rows.erase(row) == 0)
        after.rows.insert(row);
    return after;
}
} // namespace

RowSelection afterClick(const RowSelection& before, std::size_t row, Keys keys, bool severalAllowed)
{
    if (severalAllowed && keys.shift)
        return rangeTo(row, before.anchor);
    if (severalAllowed && keys.control)
        return toggled(before, row);
    return {{row}, row, row};
}

RowSelection afterStep(const RowSelection& before, long step, Keys keys, std::size_t count,
                       bool severalAllowed)
{
    if (count == 0)
        return {};
    // The first key in a list without a selection goes to its end that the key comes from.
    const long from = before.rows.empty() ? (step > 0 ? -1 : static_cast<long>(before.lead) + 1)
                                          : static_cast<long>(before.lead);
    const long row = std::clamp(from + step, 0L, static_cast<long>(count) - 1);
    return afterClick(before, static_cast<std::size_t>(row), {keys.shift && !before.rows.empty(), false},
                      severalAllowed);
}
} // namespace tessel::filepanel
