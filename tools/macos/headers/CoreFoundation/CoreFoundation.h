// What host/ui/platform/cocoa uses of CoreFoundation: declarations enough for compiling it elsewhere.
#pragma once

using CFIndex = long;
using CFOptionFlags = unsigned long;
using CFRunLoopActivity = CFOptionFlags;
using CFRunLoopRef = struct __CFRunLoop*;
using CFRunLoopObserverRef = struct __CFRunLoopObserver*;
using CFRunLoopObserverCallBack = void (*)(CFRunLoopObserverRef, CFRunLoopActivity, void* info);
struct CFRunLoopObserverContext
{
    CFIndex version;
    void* info;
    const void* (*retain)(const void* info);
    void (*release)(const void* info);
    const void* (*copyDescription)(const void* info);
};
constexpr CFRunLoopActivity kCFRunLoopBeforeWaiting = 1UL << 5;
extern "C" const struct __CFString* const kCFRunLoopCommonModes;
extern "C" CFRunLoopObserverRef CFRunLoopObserverCreate(const struct __CFAllocator*, CFOptionFlags activities,
                                                        unsigned char repeats, CFIndex order,
                                                        CFRunLoopObserverCallBack, CFRunLoopObserverContext*);
extern "C" void CFRunLoopAddObserver(CFRunLoopRef, CFRunLoopObserverRef, const struct __CFString* mode);
extern "C" CFRunLoopRef CFRunLoopGetMain();
extern "C" void CFRelease(const void*);
