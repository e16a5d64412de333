// What can be told of Lisp text without reading it as Lisp.
#pragma once

#include <cstddef>
#include <optional>
#include <string_view>

namespace tessel
{
// Lisp's reader calls itself for every level and has no guard of its own: deeper text would end the process.
inline constexpr std::size_t kDeepestNesting = 5000;

// The offset of the first top-level form that is nested more than `limit` levels deep.
std::optional<std::size_t> findTooDeepForm(std::wstring_view text, std::size_t limit = kDeepestNesting);

std::size_t countLineBreaks(std::wstring_view text);
} // namespace tessel
