#import <Foundation/Foundation.h>
#include <wincompat/winstring.h>

#include <vector>

namespace
{
constexpr unichar kReplacement = 0xFFFD;
constexpr char32_t kFirstOfTwoUnits = 0x10000;
constexpr char32_t kLastCodePoint = 0x10FFFF;

bool isHighSurrogate(unichar unit)
{
    return unit >= 0xD800 && unit < 0xDC00;
}

bool isLowSurrogate(unichar unit)
{
    return unit >= 0xDC00 && unit < 0xE000;
}

unichar single(unichar unit)
{
    return isHighSurrogate(unit) || isLowSurrogate(unit) ? kReplacement : unit;
}

wchar_t joined(unichar high, unichar low)
{
    return static_cast<wchar_t>(0x10000 + ((high - 0xD800) << 10) + (low - 0xDC00));
}

void append(std::vector<unichar>& units, char32_t code)
{
    if (code < kFirstOfTwoUnits)
        return units.push_back(single(static_cast<unichar>(code)));
    if (code > kLastCodePoint)
        return units.push_back(kReplacement);
    units.push_back(static_cast<unichar>(0xD800 + ((code - kFirstOfTwoUnits) >> 10)));
    units.push_back(static_cast<unichar>(0xDC00 + ((code - kFirstOfTwoUnits) & 0x3FF)));
}
} // namespace

std::wstring NSStringToWstring(NSString* text)
{
    const std::size_t length = [text length];
    std::vector<unichar> units(length + 1); // nothing follows the last one
    [text getCharacters:units.data() range:NSMakeRange(0, length)];
    std::wstring wide;
    wide.reserve(length);
    for (std::size_t index = 0; index < length; ++index)
    {
        const unichar unit = units[index];
        if (isHighSurrogate(unit) && isLowSurrogate(units[index + 1]))
            wide += joined(unit, units[++index]);
        else
            wide += static_cast<wchar_t>(single(unit));
    }
    return wide;
}

// Not by way of UTF-8, in which the names of some files are no text.
NSString* wcharToNSString(const wchar_t* text)
{
    if (!text)
        return nil;
    std::vector<unichar> units;
    for (; *text; ++text)
        append(units, static_cast<char32_t>(*text));
    return [NSString stringWithCharacters:units.data() length:units.size()];
}
