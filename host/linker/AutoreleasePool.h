// What the platform allocates in a scope goes at its end. For Objective-C++ only.
#pragma once

#import <Foundation/NSAutoreleasePool.h>

namespace tessel
{
class AutoreleasePool
{
public:
    AutoreleasePool() : mPool([[NSAutoreleasePool alloc] init]) {}
    ~AutoreleasePool() { [mPool drain]; }
    AutoreleasePool(const AutoreleasePool&) = delete;
    AutoreleasePool& operator=(const AutoreleasePool&) = delete;

private:
    NSAutoreleasePool* mPool;
};
} // namespace tessel
