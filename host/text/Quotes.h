// Texts in double quotes, as Lisp and registry files read them.
#pragma once

#include <string>
#include <string_view>

namespace tessel
{
// With a backslash before each double quote and each backslash.
inline std::wstring inQuotes(std::wstring_view text)
{
    std::wstring result = L"\"";
    for (const wchar_t character : text)
    {
        if (character == L'"' || character == L'\\')
            result += L'\\';
        result += character;
    }
    return result + L"\"";
}
} // namespace tessel
