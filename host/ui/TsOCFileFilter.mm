#import <tesselui/TsOCFileFilter.h>

#include <tesselui/tsuieach.h>

namespace
{
NSString* withoutWildcard(NSString* pattern)
{
    NSString* trimmed = [pattern stringByTrimmingCharactersInSet:[NSCharacterSet whitespaceCharacterSet]];
    if ([trimmed hasPrefix:@"*"])
        trimmed = [trimmed substringFromIndex:1];
    return [trimmed hasPrefix:@"."] ? [trimmed substringFromIndex:1] : trimmed;
}
} // namespace

@implementation TsOCFileFilter

- (id)initWithDescription:(NSString*)description extensionStr:(NSString*)extensions
{
    if (!(self = [super init]))
        return nil;
    NSMutableArray* list = [NSMutableArray array];
    for (NSString* pattern : tsuiEach<NSString*>([extensions componentsSeparatedByString:@";"]))
        if (NSString* extension = withoutWildcard(pattern);[extension length])
            [list addObject:extension];
    mDescription = [description copy];
    mFileExtensions = [list copy];
    return self;
}

- (void)dealloc
{
    [mDescription release];
    [mFileExtensions release];
    [super dealloc];
}

- (NSString*)description
{
    return mDescription;
}

- (NSArray*)fileExtensions
{
    return mFileExtensions;
}

@end
