#include <wincompat/winfile.h>

#include <algorithm>
#include <charconv>
#include <iterator>
#include <limits>

namespace
{
constexpr int kSmallestBase = 2;
constexpr int kLargestBase = 36;
constexpr int kDecimal = 10;
} // namespace

wchar_t* ms_itow(int value, wchar_t* buffer, int base)
{
    if (!buffer)
        return nullptr;
    wchar_t* end = buffer;
    if (base >= kSmallestBase && base <= kLargestBase)
    {
        char digits[std::numeric_limits<unsigned>::digits];
        const auto written = base == kDecimal ? std::to_chars(std::begin(digits), std::end(digits), value)
                                              : std::to_chars(std::begin(digits), std::end(digits),
                                                              static_cast<unsigned>(value), base);
        end = std::copy(std::begin(digits), written.ptr, buffer);
    }
    *end = L'\0';
    return buffer;
}
