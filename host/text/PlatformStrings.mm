#import <Foundation/Foundation.h>
#include <wincompat/winstring.h>

#include <vector>

#include "host/text/Unicode.h"

namespace
{
constexpr wchar_t kReplacement = 0xFFFD;

bool isHighSurrogate(unichar unit)
{
    return unit >= 0xD800 && unit < 0xDC00;
}

bool isLowSurrogate(unichar unit)
{
    return unit >= 0xDC00 && unit < 0xE000;
}

wchar_t joined(unichar high, unichar low)
{
    return static_cast<wchar_t>(0x10000 + ((high - 0xD800) << 10) + (low - 0xDC00));
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
            wide += isHighSurrogate(unit) || isLowSurrogate(unit) ? kReplacement : static_cast<wchar_t>(unit);
    }
    return wide;
}

NSString* wcharToNSString(const wchar_t* text)
{
    return text ? [NSString stringWithUTF8String:tessel::toUtf8(text).c_str()] : nil;
}
