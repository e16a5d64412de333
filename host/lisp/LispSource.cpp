#include "host/lisp/LispSource.h"

#include <algorithm>

#include "host/text/LispScanner.h"

namespace tessel
{
std::optional<std::size_t> findTooDeepForm(std::wstring_view text, std::size_t limit)
{
    LispScanner scanner;
    for (const wchar_t character : text)
    {
        scanner.take(character);
        if (scanner.levels() > limit)
            return scanner.startOfForm();
    }
    return std::nullopt;
}

std::size_t countLineBreaks(std::wstring_view text)
{
    return static_cast<std::size_t>(std::count(text.begin(), text.end(), L'\n'));
}
} // namespace tessel
