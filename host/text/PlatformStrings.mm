#import <Foundation/Foundation.h>
#include <wincompat/winstring.h>

#include "host/text/Unicode.h"

std::wstring NSStringToWstring(NSString* text)
{
    const char* utf8 = [text UTF8String];
    return utf8 ? tessel::toWide(utf8) : std::wstring();
}

NSString* wcharToNSString(const wchar_t* text)
{
    return text ? [NSString stringWithUTF8String:tessel::toUtf8(text).c_str()] : nil;
}
