// What modrig/dialogs/platform/cocoa uses of CoreServices: declarations enough for compiling it elsewhere.
#pragma once

using UInt8 = unsigned char;
using Boolean = unsigned char;
using OSStatus = int;
struct FSRef
{
    UInt8 hidden[80];
};
constexpr OSStatus noErr = 0;
extern "C" OSStatus FSPathMakeRef(const UInt8* path, FSRef* reference, Boolean* isFolder);
