// Where a path leads in the end.
#pragma once

#import <Foundation/NSString.h>

@interface NSString (ModrigPaths)

// The path with symbolic links resolved and, where the platform has them, alias files too. A part of it that
// does not exist stays as it is.
- (NSString*)stringByResolvingSymlinksAndAliasesInPath;

@end
