// A number by which equal paths are found among many.
#pragma once

#include <cstddef>
#include <string_view>

namespace ModrigUtils
{
// The same for all paths that the toolkit finds equal without regard to case, and seldom the same for others.
[[nodiscard]] std::size_t HashOfPath(std::wstring_view path);
} // namespace ModrigUtils
