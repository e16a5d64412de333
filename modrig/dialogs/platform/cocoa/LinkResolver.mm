#include "modrig/dialogs/platform/LinkResolver.h"

#import <Foundation/Foundation.h>

#include "modrig/dialogs/Paths.h"

namespace ModrigPlatform
{
LinkResolver MakeLinkResolver()
{
    CStdStr resolved;
    return [resolved](const CStdStr& path) mutable -> const CStdStr&
    {
        NSString* text = ModrigUtils::StringFromPath(path);
        resolved = ModrigUtils::PathFromString([text stringByResolvingSymlinksInPath]);
        return resolved;
    };
}
} // namespace ModrigPlatform
