#include "modrig/dialogs/model/PathHash.h"

#include <array>
#include <functional>
#include <string>

namespace ModrigUtils
{
namespace
{
constexpr char16_t kLastAscii = 0x7F;
// The accents that are characters of their own.
constexpr char16_t kFirstAccent = 0x0300;
constexpr char16_t kLastAccent = 0x036F;

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

bool IsAccent(std::u16string_view path, std::size_t index)
{
    return index < path.size() && path[index] >= kFirstAccent && path[index] <= kLastAccent;
}
} // namespace

// Paths that are equal may differ in more than their letters' case: an accent can be a character of its own,
// after its letter, or part of it. So a letter counts only where no such character follows. Any other
// character that follows leaves it alone: what that one is equal to may be a plain letter.
std::size_t HashOfPath(std::u16string_view path)
{
    std::string certain;
    certain.reserve(path.size());
    for (std::size_t index = 0; index < path.size(); ++index)
        if (path[index] <= kLastAscii && !IsAccent(path, index + 1) && kCertain[path[index]])
            certain += kCertain[path[index]];
    return std::hash<std::string>()(certain);
}
} // namespace ModrigUtils
