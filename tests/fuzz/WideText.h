// Wide text out of the fuzzer's bytes: each character is one of the bytes' few or, after a 0xff, four bytes
// as they are.
#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string>

inline std::wstring wideText(const std::uint8_t* data, std::size_t size)
{
    constexpr std::uint8_t kWhole = 0xff;
    std::wstring text;
    for (std::size_t i = 0; i < size; ++i)
    {
        wchar_t character = data[i];
        if (data[i] == kWhole && size - i > sizeof character)
        {
            std::memcpy(&character, data + i + 1, sizeof character);
            i += sizeof character;
        }
        text += character;
    }
    return text;
}
