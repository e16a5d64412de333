#include "host/resources/ModuleLanguages.h"

#include <algorithm>
#include <tuple>

#include <unicode/uloc.h>

namespace tessel
{
namespace
{
constexpr unsigned kLanguageBits = 10;
constexpr LanguageNumber kCountriesBegin = 1;
constexpr LanguageNumber kCountriesEnd = 0x1e; // from here on, numbers stand for kinds of a language

LanguageNumber languageIn(LanguageNumber number)
{
    return number & ((1U << kLanguageBits) - 1);
}

LanguageNumber countryIn(LanguageNumber number)
{
    return number >> kLanguageBits;
}

bool namesACountry(LanguageNumber number)
{
    return countryIn(number) >= kCountriesBegin && countryIn(number) < kCountriesEnd;
}

bool suits(LanguageNumber language, LanguageNumber wanted)
{
    return language == wanted || (!namesACountry(wanted) && languageIn(language) == languageIn(wanted));
}

// Of a language without and with countries, the one without comes first, then the main country's.
std::tuple<std::size_t, LanguageNumber> rank(LanguageNumber language,
                                             const std::vector<LanguageNumber>& wanted)
{
    const auto found = std::ranges::find_if(wanted, [&](LanguageNumber one) { return suits(language, one); });
    const LanguageNumber country = found == wanted.end() ? 0 : std::min(countryIn(language), 2U);
    return {static_cast<std::size_t>(found - wanted.begin()), country};
}
} // namespace

std::vector<LanguageNumber> numbersOf(const std::vector<std::string>& names)
{
    std::vector<LanguageNumber> numbers;
    for (const std::string& name : names)
        if (const LanguageNumber number = uloc_getLCID(name.c_str()))
            numbers.push_back(number);
    return numbers;
}

std::vector<LanguageNumber> inWantedOrder(const std::vector<LanguageNumber>& ofTheModule,
                                          const std::vector<LanguageNumber>& wanted)
{
    std::vector<LanguageNumber> languages = ofTheModule;
    std::ranges::stable_sort(languages, {}, [&](LanguageNumber language) { return rank(language, wanted); });
    return languages;
}
} // namespace tessel
