#import "modrig/dialogs/NSString+ModrigPaths.h"

@implementation NSString (ModrigPaths)

- (NSString*)stringByResolvingSymlinksAndAliasesInPath
{
    return [self stringByResolvingSymlinksInPath]; // there are no aliases here
}

@end
