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

// Not by way of UTF-8, in which the names of some files are no text.
NSString* wcharToNSString(const wchar_t* text)
{
    if (!text)
        return nil;
    const std::u16string units = tessel::toUtf16(text);
    return [NSString stringWithCharacters:reinterpret_cast<const unichar*>(units.data()) length:units.size()];
}
