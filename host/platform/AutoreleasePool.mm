#include "host/platform/AutoreleasePool.h"

#import <Foundation/NSAutoreleasePool.h>

namespace tessel
{
AutoreleasePool::AutoreleasePool() : mPool([[NSAutoreleasePool alloc] init])
{
}

AutoreleasePool::~AutoreleasePool()
{
    [static_cast<NSAutoreleasePool*>(mPool) drain];
}
} // namespace tessel
