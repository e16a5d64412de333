// Text on its way to a person's terminal, whoever wrote it: the name of a file, Lisp, another program.
#pragma once

#include <string>
#include <string_view>

namespace tessel
{
// What a terminal would take for an order, and a byte that is no text, stands as an escape: \x1B. Line breaks
// and tabs stay as they are; a carriage return before a line break goes. Names and passwords in addresses are
// left out.
std::wstring forTerminal(std::wstring_view text);
} // namespace tessel
