// The characters that a terminal takes for orders.
#pragma once

namespace tessel
{
// Those from U+0080 on are what some terminals take for an escape and a letter.
constexpr bool isControl(char32_t code)
{
    constexpr char32_t kDelete = 0x7F;
    constexpr char32_t kLast = 0x9F;
    return code < U' ' || (code >= kDelete && code <= kLast);
}
} // namespace tessel
