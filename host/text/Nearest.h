// Which of several names somebody meant who has mistyped one.
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace tessel
{
// The name with the fewest letters missing, added, replaced or swapped with their neighbour, the first of
// several; without regard to case. Nothing where none is near: one such slip in a short name, two in one of
// six letters and more. The beginning of a single name, from three letters on, is that name.
std::optional<std::wstring> nearest(std::wstring_view typed, const std::vector<std::wstring>& names);
} // namespace tessel
