#include "modrig/dialogs/model/PathHash.h"

#include <array>
#include <cstdint>

namespace ModrigUtils
{
namespace
{
constexpr wchar_t kLastAscii = 0x7F;
// The accents that are characters of their own.
constexpr wchar_t kFirstAccent = 0x0300;
constexpr wchar_t kLastAccent = 0x036F;

// Nothing else is equal to these and their capitals without regard to case. Left out are the letters that
// something is: the s (long s), the k (Kelvin), those of ligatures.
constexpr std::string_view kUnmistakable = "0123456789/._-bcdeghmopqruvwxyz";

// The lower-case letter of each unmistakable character, and 0 of every other one.
constexpr auto kCertain = []
{
    std::array<char, kLastAscii + 1> certain = {};
    for (const char character : kUnmistakable)
    {
        certain[static_cast<std::size_t>(character)] = character;
        if (character >= 'a' && character <= 'z')
            certain[static_cast<std::size_t>('A') + static_cast<std::size_t>(character - 'a')] = character;
    }
    return certain;
}();

bool IsAccent(std::wstring_view path, std::size_t index)
{
    return index < path.size() && path[index] >= kFirstAccent && path[index] <= kLastAccent;
}

// FNV-1a: bytes as they come, none of them kept.
constexpr std::uint64_t kHashStart = 0xCBF29CE484222325;
constexpr std::uint64_t kHashFactor = 0x100000001B3;
} // namespace

// Paths that are equal may differ in more than their letters' case: an accent can be a character of its own,
// after its letter, or part of it. So a letter counts only where no such character follows. Any other
// character that follows leaves it alone: what that one is equal to may be a plain letter.
std::size_t HashOfPath(std::wstring_view path)
{
    std::uint64_t hash = kHashStart;
    for (std::size_t index = 0; index < path.size(); ++index)
    {
        const auto character = static_cast<char32_t>(path[index]);
        if (character <= kLastAscii && kCertain[character] && !IsAccent(path, index + 1))
            hash = (hash ^ static_cast<unsigned char>(kCertain[character])) * kHashFactor;
    }
    return hash;
}
} // namespace ModrigUtils
