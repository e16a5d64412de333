// Which font has a character.
#pragma once

#include <string>

namespace tessel::windowing
{
// The name, as the toolkit knows fonts, of the installed one without serifs that comes closest and has the
// character; empty when none has it.
std::string fontWith(char32_t character, bool bold);
} // namespace tessel::windowing
