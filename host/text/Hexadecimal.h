// Bytes as two hexadecimal digits.
#pragma once

#include <string>
#include <string_view>

namespace tessel
{
inline constexpr std::string_view kLargeHexDigits = "0123456789ABCDEF";
inline constexpr std::string_view kSmallHexDigits = "0123456789abcdef";

// "1B" of 27.
template <class Character>
std::basic_string<Character> hexadecimal(unsigned char byte, std::string_view digits = kLargeHexDigits)
{
    return {static_cast<Character>(digits[byte >> 4]), static_cast<Character>(digits[byte & 0xF])};
}

// How a byte is shown that cannot be: "\x1B".
template <class Character>
std::basic_string<Character> shownByte(unsigned char byte)
{
    return std::basic_string<Character>{Character{'\\'}, Character{'x'}} + hexadecimal<Character>(byte);
}
} // namespace tessel
