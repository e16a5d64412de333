// A name for one case of a table: its number and what ctest can take of its text.
#pragma once

#include <string>
#include <string_view>

inline std::string caseName(std::size_t index, std::wstring_view text)
{
    std::string name = std::to_string(index) + "_";
    for (const wchar_t character : text)
    {
        const bool plain = (character >= L'a' && character <= L'z') ||
                           (character >= L'A' && character <= L'Z') ||
                           (character >= L'0' && character <= L'9');
        name += plain ? static_cast<char>(character) : '_';
    }
    return name;
}
