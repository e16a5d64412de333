#include "host/text/Credentials.h"

#include <algorithm>

namespace tessel
{
namespace
{
constexpr std::wstring_view kAfterScheme = L"://";
// Where the part of an address ends in which a name can stand: at its path, or where the address ends.
constexpr std::wstring_view kEnds = L"/?#\" \t\r\n";
} // namespace

std::wstring withoutCredentials(std::wstring_view text)
{
    std::wstring result;
    for (std::size_t mark = text.find(kAfterScheme); mark != text.npos; mark = text.find(kAfterScheme))
    {
        result += text.substr(0, mark + kAfterScheme.size());
        text.remove_prefix(mark + kAfterScheme.size());
        const std::size_t end = std::min(text.find_first_of(kEnds), text.size());
        const std::size_t at = text.substr(0, end).rfind(L'@');
        text.remove_prefix(at == text.npos ? 0 : at + 1);
    }
    return result.append(text);
}
} // namespace tessel
