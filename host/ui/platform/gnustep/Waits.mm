// The modal loops of the toolkit fetch their events past the application object. What every wait goes through
// is the run loop's own.
#import <Foundation/Foundation.h>

#include "host/platform/gnustep/StandIn.h"
#include "host/ui/platform/Windowing.h"

namespace tessel::windowing
{
namespace
{
using AcceptInput = void (*)(id, SEL, NSString*, NSDate*);
AcceptInput toolkitAcceptInput;
void (*beforeWait)();

void acceptInput(id loop, SEL selector, NSString* mode, NSDate* limit)
{
    // Threads have run loops of their own.
    if ([NSThread isMainThread])
        beforeWait();
    toolkitAcceptInput(loop, selector, mode, limit);
}
} // namespace

void callBeforeEachWait(void (*call)())
{
    beforeWait = call;
    toolkitAcceptInput = standInFor("NSRunLoop", @selector(acceptInputForMode:beforeDate:), acceptInput);
}
} // namespace tessel::windowing
