// Where the keys that move in a table go when not every row can be selected.
#pragma once

#include <cstddef>
#include <functional>
#include <optional>

namespace ModrigUtils
{
struct RowPlaces
{
    std::size_t rows = 0;
    std::size_t page = 1; // how many rows a page key goes
    std::optional<std::size_t> selected;
};

// The row that an arrow, page, Home or End key goes to: the nearest beyond its goal that can be selected, or
// else before it. None for other keys, and where no row can be selected.
[[nodiscard]] std::optional<std::size_t> RowForKey(wchar_t key, const RowPlaces& places,
                                                   const std::function<bool(std::size_t)>& canBeSelected);

// The same where a toolkit that does not ask which rows can be selected would go to another row; none where
// it goes there by itself.
[[nodiscard]] std::optional<std::size_t>
RowPassedOverFor(wchar_t key, const RowPlaces& places, const std::function<bool(std::size_t)>& canBeSelected);
} // namespace ModrigUtils
