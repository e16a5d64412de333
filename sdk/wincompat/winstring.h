// Wide strings and the platform's string objects. For Objective-C++ only.
#pragma once

#import <Foundation/NSString.h>
#include <string>

#include "../tessel/tsdefs.h"

// The names of files need not be text. A byte NN of such a name is the character U+10FENN here, in all wide
// texts and strings of the host, and the file is found by it.

// The text as 4-byte wide characters; empty for nil.
TESSEL_API std::wstring NSStringToWstring(NSString* text);

// An autoreleased string; nil for null. Values that are no Unicode scalar become U+FFFD.
TESSEL_API NSString* wcharToNSString(const wchar_t* text);
