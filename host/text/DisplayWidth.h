// How much room text takes where every character stands in cells of one size: a terminal.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace tessel
{
// Cells: two for wide characters (Chinese, Japanese, Korean, most emoji), none for accents that stand on the
// character before them and for what is never seen. Whatever the locale is.
std::size_t displayWidth(wchar_t character);
std::size_t displayWidth(std::wstring_view text);

// The text, filled up with blanks to the width of a column; a longer one stays as it is.
std::wstring padded(std::wstring text, std::size_t cells);

// The text in lines of at most that width, at least one, broken at blanks; the blanks where it is broken go.
// A word that is wider is broken where the line is full, and a character stays with its accents. What is
// several lines already stays so.
std::vector<std::wstring> wrapped(std::wstring_view text, std::size_t cells);
} // namespace tessel
