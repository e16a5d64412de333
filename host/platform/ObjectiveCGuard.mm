#include "host/platform/ObjectiveCGuard.h"

#import <Foundation/Foundation.h>

#include "host/platform/AutoreleasePool.h"
#include "host/text/Unicode.h"

extern "C" id tesselCatch(void (*call)(const void* context), const void* context);

namespace tessel
{
Result<> catchObjectiveC(const std::function<void()>& call)
{
    const id thrown = tesselCatch(
        [](const void* context) { (*static_cast<const std::function<void()>*>(context))(); }, &call);
    if (!thrown)
        return {};
    const AutoreleasePool pool;
    NSString* text = [thrown isKindOfClass:[NSException class]]
                         ? [NSString stringWithFormat:@"%@: %@", [(NSException*)thrown name],
                                                      [(NSException*)thrown reason]]
                         : [thrown description];
    return Failure{toWide([text UTF8String])};
}
} // namespace tessel
