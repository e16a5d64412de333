#import "ui/ModrigFilePath.h"

#include <wincompat/winstring.h>

#include "loader/LoadedApplications.h"

@implementation ModrigFilePath

@synthesize filePathName = mFilePathName;
@synthesize fileName = mFileName;
@synthesize filePath = mFilePath;
@synthesize unloadable = mUnloadable;

- (id)initWithFilePathName:(NSString*)path
{
    if (!(self = [self initWithResolvedPath:path]) || !path)
        return self;
    [mFilePathName release];
    mFilePathName = [[path stringByResolvingSymlinksInPath] copy];
    return self;
}

- (id)initWithResolvedPath:(NSString*)path
{
    if (!(self = [super init]) || !path)
        return self;
    mFilePathName = [path copy];
    mFileName = [[path lastPathComponent] copy];
    mFilePath = [[path stringByDeletingLastPathComponent] copy];
    mUnloadable = ModrigUtils::IsAppUnloadAble(CStdStr(NSStringToWstring(path)));
    return self;
}

- (void)dealloc
{
    [mFilePathName release];
    [mFileName release];
    [mFilePath release];
    [super dealloc];
}

- (CStdStr)path
{
    return CStdStr(NSStringToWstring(mFilePathName));
}

- (BOOL)isEqual:(id)other
{
    if (![other isKindOfClass:[self class]])
        return NO;
    NSString* path = [other filePathName];
    if (!mFilePathName || !path)
        return mFilePathName == path;
    return [mFilePathName caseInsensitiveCompare:path] == NSOrderedSame;
}

- (NSUInteger)hash
{
    return [[mFilePathName lowercaseString] hash];
}

@end
