// The languages of a resource module, by the numbers that resource scripts know them by: the lower ten bits
// name the language, the others the country. 0x0007 is German of any country, 0x0407 that of Germany, 0x0c07
// that of Austria.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace tessel
{
using LanguageNumber = std::uint32_t;

// The numbers of languages by their names ("de_AT", "de"), in their order; names that nobody knows are left
// out.
std::vector<LanguageNumber> numbersOf(const std::vector<std::string>& names);

// The languages that a module has, which come in the module's order, in the order in which a person's texts
// are looked up: first the wanted ones, then all others. Wanting a language without a country is wanting it
// of any.
std::vector<LanguageNumber> inWantedOrder(const std::vector<LanguageNumber>& ofTheModule,
                                          const std::vector<LanguageNumber>& wanted);
} // namespace tessel
