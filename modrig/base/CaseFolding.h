// Comparing text without regard to case: Unicode's simple case folding, character by character, the same in
// every locale.
#pragma once

#include <cstddef>
#include <string_view>

wchar_t FoldCase(wchar_t character);

// Less than, equal to or greater than 0, in the order of the folded characters.
int CompareIgnoringCase(std::wstring_view left, std::wstring_view right);

bool EqualIgnoringCase(std::wstring_view left, std::wstring_view right);

// Texts that are equal without regard to case have the same hash. `seed` chains several texts into one.
std::size_t HashIgnoringCase(std::wstring_view text, std::size_t seed = 0);
