#include "modrig/base/CaseFolding.h"

#include <algorithm>
#include <bit>
#include <cstdint>
#include <iterator>

#include "modrig/base/CaseFoldingTable.h"

namespace
{
wchar_t FoldBeyondAscii(wchar_t character)
{
    const auto code = static_cast<unsigned>(character);
    const auto* after =
        std::upper_bound(std::begin(kCaseFoldingRanges), std::end(kCaseFoldingRanges), code,
                         [](unsigned value, const CaseFoldingRange& range) { return value < range.first; });
    if (after == std::begin(kCaseFoldingRanges))
        return character;
    const CaseFoldingRange& range = *std::prev(after);
    if (code > range.last || (code - range.first) % range.step != 0)
        return character;
    return static_cast<wchar_t>(static_cast<int>(code) + range.delta);
}

// The same for characters that are equal without regard to case. So that nearly all of them need but one
// look, it is the same for some others too: letters of ASCII differ from their capitals by this bit, and a
// few of its signs from each other.
std::uint32_t HashedCharacter(wchar_t character)
{
    constexpr std::uint32_t kSmall = L'a' - L'A';
    const bool isAscii = static_cast<std::uint32_t>(character) < 0x80;
    return kSmall | static_cast<std::uint32_t>(isAscii ? character : FoldBeyondAscii(character));
}
} // namespace

wchar_t FoldCase(wchar_t character)
{
    if (character >= L'A' && character <= L'Z')
        return character + (L'a' - L'A');
    if (character < 0x80)
        return character;
    return FoldBeyondAscii(character);
}

int CompareIgnoringCase(std::wstring_view left, std::wstring_view right)
{
    const std::size_t common = std::min(left.size(), right.size());
    for (std::size_t i = 0; i < common; ++i)
    {
        if (left[i] == right[i])
            continue;
        const wchar_t a = FoldCase(left[i]);
        const wchar_t b = FoldCase(right[i]);
        if (a != b)
            return a < b ? -1 : 1;
    }
    if (left.size() == right.size())
        return 0;
    return left.size() < right.size() ? -1 : 1;
}

bool EqualIgnoringCase(std::wstring_view left, std::wstring_view right)
{
    return left.size() == right.size() && CompareIgnoringCase(left, right) == 0;
}

// FNV-1a over the folded characters, those at even and at odd places by themselves: each multiplication waits
// for the one before it, and two rows of them run side by side.
std::size_t HashIgnoringCase(std::wstring_view text, std::size_t seed)
{
    constexpr std::uint64_t kOffset = 14695981039346656037ull;
    constexpr std::uint64_t kPrime = 1099511628211ull;
    constexpr int kApart = 29;
    std::uint64_t even = kOffset ^ seed;
    std::uint64_t odd = kOffset;
    std::size_t at = 0;
    for (; at + 1 < text.size(); at += 2)
    {
        even = (even ^ HashedCharacter(text[at])) * kPrime;
        odd = (odd ^ HashedCharacter(text[at + 1])) * kPrime;
    }
    if (at < text.size())
        even = (even ^ HashedCharacter(text[at])) * kPrime;
    return even ^ std::rotl(odd, kApart);
}
