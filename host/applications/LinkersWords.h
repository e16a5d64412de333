// What the system's linker says, for people.
#pragma once

#include <string>
#include <string_view>

namespace tessel
{
// The words with every symbol of C++ as it stands in the source: "_Z4turni" as "turn(int)". A symbol stands
// between blanks or before a comma; names of files stay as they are.
std::string withReadableSymbols(std::string_view words);
} // namespace tessel
