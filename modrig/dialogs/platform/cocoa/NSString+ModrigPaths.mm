#import "modrig/dialogs/NSString+ModrigPaths.h"

#import <Foundation/Foundation.h>

@implementation NSString (ModrigPaths)

- (NSString*)stringByResolvingSymlinksAndAliasesInPath
{
    NSString* path = [self stringByResolvingSymlinksInPath];
    NSURL* original = [NSURL URLByResolvingAliasFileAtURL:[NSURL fileURLWithPath:path]
                                                  options:NSURLBookmarkResolutionWithoutUI
                                                    error:NULL];
    return original ? [original path] : path;
}

@end
