#import <Foundation/Foundation.h>
#include <wincompat/winstring.h>

#include <string>

#include "host/text/Unicode.h"

static_assert(sizeof(unichar) == sizeof(char16_t));

std::wstring NSStringToWstring(NSString* text)
{
    std::u16string units([text length], u'\0');
    [text getCharacters:reinterpret_cast<unichar*>(units.data()) range:NSMakeRange(0, units.size())];
    return tessel::toWide(units);
}

namespace
{
constexpr wchar_t kFirstBeyondAscii = 0x80;
constexpr std::size_t kRoomForMost = 256;

// Nearly all text is short, and ASCII, which the platform takes over as it is. Nil for any other.
NSString* shortAscii(const wchar_t* text)
{
    char ascii[kRoomForMost];
    std::size_t length = 0;
    while (length < kRoomForMost && text[length] > 0 && text[length] < kFirstBeyondAscii)
    {
        ascii[length] = static_cast<char>(text[length]);
        ++length;
    }
    if (length == kRoomForMost || text[length])
        return nil;
    ascii[length] = '\0';
    return [NSString stringWithUTF8String:ascii];
}
} // namespace

// Not by way of UTF-8, in which the names of some files are no text.
NSString* wcharToNSString(const wchar_t* text)
{
    if (!text)
        return nil;
    if (NSString* ascii = shortAscii(text))
        return ascii;
    const std::u16string units = tessel::toUtf16(text);
    return [NSString stringWithCharacters:reinterpret_cast<const unichar*>(units.data()) length:units.size()];
}
