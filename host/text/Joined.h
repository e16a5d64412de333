// Texts in a row.
#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace tessel
{
inline std::wstring joined(const std::vector<std::wstring>& texts, std::wstring_view between)
{
    std::wstring all;
    for (const std::wstring& text : texts)
    {
        if (&text != &texts.front())
            all += between;
        all += text;
    }
    return all;
}
} // namespace tessel
