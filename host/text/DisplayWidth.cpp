#include "host/text/DisplayWidth.h"

#include <unicode/uchar.h>

#include <algorithm>

namespace tessel
{
namespace
{
constexpr wchar_t kFirstWide = 0x1100; // Hangul; nearly all text ends before

bool isUnseen(wchar_t character)
{
    constexpr wchar_t kFirstAccent = 0x300;
    constexpr wchar_t kSoftHyphen = 0xAD; // terminals show it
    if (character < kFirstAccent)
        return character == L'\0';
    constexpr auto kUnseen = U_GC_MN_MASK | U_GC_ME_MASK | U_GC_CF_MASK;
    const auto code = static_cast<UChar32>(character);
    const auto syllablePart = u_getIntPropertyValue(code, UCHAR_HANGUL_SYLLABLE_TYPE);
    const bool joinsTheLast = syllablePart == U_HST_VOWEL_JAMO || syllablePart == U_HST_TRAILING_JAMO;
    return character != kSoftHyphen && ((U_GET_GC_MASK(code) & kUnseen) != 0 || joinsTheLast);
}

bool isWide(wchar_t character)
{
    if (character < kFirstWide)
        return false;
    const auto width = u_getIntPropertyValue(static_cast<UChar32>(character), UCHAR_EAST_ASIAN_WIDTH);
    return width == U_EA_WIDE || width == U_EA_FULLWIDTH;
}

// How many characters of the text fit; at least one.
std::size_t countOfFitting(std::wstring_view text, std::size_t cells)
{
    std::size_t count = 0;
    std::size_t used = 0;
    while (count < text.size() && (count == 0 || used + displayWidth(text[count]) <= cells))
        used += displayWidth(text[count++]);
    return count;
}

// Where the first line of the text ends: at the last blank that leaves room, or in a word that has none.
std::size_t endOfLine(std::wstring_view text, std::size_t cells)
{
    const std::size_t fitting = countOfFitting(text, cells);
    if (fitting == text.size() || text[fitting] == L' ')
        return fitting;
    const std::size_t blank = text.rfind(L' ', fitting);
    const bool isAfterWord = blank != text.npos && text.find_first_not_of(L' ') < blank;
    return isAfterWord ? blank : fitting;
}
} // namespace

std::size_t displayWidth(wchar_t character)
{
    if (isUnseen(character))
        return 0;
    return isWide(character) ? 2 : 1;
}

std::size_t displayWidth(std::wstring_view text)
{
    std::size_t cells = 0;
    for (const wchar_t character : text)
        cells += displayWidth(character);
    return cells;
}

std::wstring padded(std::wstring text, std::size_t cells)
{
    const std::size_t used = displayWidth(text);
    text.append(cells > used ? cells - used : 0, L' ');
    return text;
}

std::vector<std::wstring> wrapped(std::wstring_view text, std::size_t cells)
{
    std::vector<std::wstring> lines;
    while (!text.empty() || lines.empty())
    {
        const std::size_t end = endOfLine(text.substr(0, text.find(L'\n')), std::max<std::size_t>(cells, 1));
        const auto line = text.substr(0, end);
        lines.emplace_back(line.substr(0, line.find_last_not_of(L' ') + 1));
        text.remove_prefix(std::min(text.find_first_not_of(L' ', end), text.size()));
        if (text.starts_with(L'\n'))
            text.remove_prefix(1);
    }
    return lines;
}
} // namespace tessel
