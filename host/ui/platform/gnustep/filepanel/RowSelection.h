// Which rows of a list are selected after a click or a key. Shift takes ranges and Control single rows.
#pragma once

#include <cstddef>
#include <set>

namespace tessel::filepanel
{
struct RowSelection
{
    std::set<std::size_t> rows;
    std::size_t anchor = 0; // where ranges begin
    std::size_t lead = 0;   // where the keyboard is
};

struct Keys
{
    bool shift = false;
    bool control = false;
};

RowSelection afterClick(const RowSelection& before, std::size_t row, Keys keys, bool severalAllowed);

// `step`: how many rows down (negative: up) the arrow, page or end keys go, in a list of `count` rows.
RowSelection afterStep(const RowSelection& before, long step, Keys keys, std::size_t count,
                       bool severalAllowed);
} // namespace tessel::filepanel
