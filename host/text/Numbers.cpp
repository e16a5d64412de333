#include <wincompat/winfile.h>

#include <algorithm>

wchar_t* ms_itow(int value, wchar_t* buffer, int base)
{
    constexpr int kSmallestBase = 2;
    constexpr int kLargestBase = 36;
    constexpr int kDecimal = 10;
    if (!buffer)
        return nullptr;
    wchar_t* end = buffer;
    if (base >= kSmallestBase && base <= kLargestBase)
    {
        const bool negative = value < 0 && base == kDecimal;
        const auto radix = static_cast<unsigned>(base);
        auto rest = static_cast<unsigned>(value);
        if (negative)
            rest = 0u - rest;
        do
        {
            *end++ = L"0123456789abcdefghijklmnopqrstuvwxyz"[rest % radix];
            rest /= radix;
        } while (rest > 0);
        if (negative)
            *end++ = L'-';
        std::reverse(buffer, end);
    }
    *end = L'\0';
    return buffer;
}
