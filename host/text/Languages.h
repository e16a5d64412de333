// The languages that the person wants texts in.
#pragma once

#include <string>
#include <vector>

namespace tessel
{
// As the environment tells, the most wanted first, each once: "de_AT" and then "de", without encodings and
// modifiers. LC_ALL says, else LC_MESSAGES, else LANG; LANGUAGE, a list with colons, stands before what they
// say, unless they ask for the plain texts of the programs, by "C" or "POSIX" in any encoding or by nothing.
// Then the list is empty.
std::vector<std::string> personsLanguages();
} // namespace tessel
