// What the host says to a person, in that person's language.
//
// A sentence stands in English where it is said: as one literal, whole, with a place {} for each thing that
// is put in. Translators find it by the names of these functions, and write it into host/languages/.
//
//     translated(L"The registry {} could not be read: {}.", file, reason)
//     translatedByCount(starts, L"{} start is left", L"{} starts are left")
//     constexpr auto kCutShort = Sentence(L"the file is cut short");       translated(kCutShort)
//
// Without a translation, or with one whose places do not fit, the English is said. What programs read (JSON,
// registry files, names of commands and options) is not put through here.
#pragma once

#include <cstddef>
#include <filesystem>
#include <initializer_list>
#include <string>
#include <string_view>
#include <type_traits>
#include <vector>

#include "host/text/Unicode.h"

namespace tessel
{
// From now on what is said is in the first of these languages for which the folder has a catalogue,
// `de/LC_MESSAGES/tessel.mo`; in English when that stands before it, or there is none. Nothing may be said by
// another thread meanwhile.
void useTranslations(const std::filesystem::path& folder, const std::vector<std::string>& languages);

// Where something is put in: {}, or {1} to {9} where another language wants another order.
struct Place
{
    std::size_t length = 0; // 0: no place
    std::size_t number = 0; // 0: the next thing

    // Safe in a signal handler.
    template <class Character>
    static constexpr Place at(std::basic_string_view<Character> text) noexcept
    {
        if (text.size() < 2 || text[0] != '{')
            return {};
        if (text[1] == '}')
            return {2, 0};
        const bool isNumbered = text.size() > 2 && text[1] >= '1' && text[1] <= '9' && text[2] == '}';
        return isNumbered ? Place{3, static_cast<std::size_t>(text[1] - '0')} : Place();
    }
};

// Whether the text has a place for each of so many things: all plain, one for each, or all with a number.
constexpr bool hasPlacesFor(std::size_t things, std::wstring_view text)
{
    std::size_t plain = 0;
    unsigned numbers = 0; // a bit for each
    for (; !text.empty(); text.remove_prefix(1))
        if (const Place place = Place::at(text); place.number > 0)
            numbers |= 1u << (place.number - 1);
        else if (place.length > 0)
            ++plain;
    return numbers == 0 ? plain == things : plain == 0 && numbers == (1u << things) - 1;
}

// A sentence in English with places for so many things; the compiler sees to it.
template <std::size_t kThings = 0>
struct Sentence
{
    consteval Sentence(const wchar_t* text) : english(text)
    {
        if (!hasPlacesFor(kThings, text))
            throw "the places of the sentence are not as many as what is put in";
    }

    const wchar_t* english;
};
Sentence(const wchar_t*)->Sentence<>;

// How something is put in.
template <class Thing>
std::wstring asWords(const Thing& thing)
{
    if constexpr (std::is_same_v<Thing, std::filesystem::path>)
        return toWide(thing.native());
    else if constexpr (std::is_integral_v<Thing>)
        return std::to_wstring(thing);
    else
        return std::wstring(thing);
}

// Of a text that the compiler has not seen, such as an application's: where its places are not as many as the
// things it stays as it is.
std::wstring translateAndFill(const wchar_t* english, std::initializer_list<std::wstring> things);
std::wstring translateAndFill(const wchar_t* one, const wchar_t* several, std::size_t count,
                              std::initializer_list<std::wstring> things);

// The same of a text without places, such as those that are kept in English since programs read them.
inline std::wstring inPersonsLanguage(const std::wstring& english)
{
    return translateAndFill(english.c_str(), {});
}

template <class... Things>
std::wstring translated(Sentence<sizeof...(Things)> sentence, const Things&... things)
{
    return translateAndFill(sentence.english, {asWords(things)...});
}

inline std::string translatedInUtf8(Sentence<> sentence)
{
    return toUtf8(translated(sentence));
}

// The count is what is put in first, into either sentence.
template <class... Things>
std::wstring translatedByCount(std::size_t count, Sentence<sizeof...(Things) + 1> one,
                               Sentence<sizeof...(Things) + 1> several, const Things&... things)
{
    return translateAndFill(one.english, several.english, count, {asWords(count), asWords(things)...});
}
} // namespace tessel
