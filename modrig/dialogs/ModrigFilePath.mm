#import "modrig/dialogs/ModrigFilePath.h"

#include <wincompat/winstring.h>

#include <string>

#include "modrig/dialogs/Paths.h"
#include "modrig/dialogs/model/PathHash.h"
#include "modrig/loader/LoadedApplications.h"

@implementation ModrigFilePath

@synthesize filePathName = mFilePathName;
@synthesize unloadable = mUnloadable;

- (id)initWithFilePathName:(NSString*)path
{
    if (!path)
        return [super init];
    if (!(self = [self initWithResolvedPath:ModrigUtils::PathFromString(path)]))
        return nil;
    mFileName = [[path lastPathComponent] copy];
    mFilePath = [[path stringByDeletingLastPathComponent] copy];
    [mFilePathName release];
    mFilePathName = [[path stringByResolvingSymlinksInPath] copy];
    return self;
}

- (id)initWithResolvedPath:(const CStdStr&)path
{
    if (!(self = [super init]))
        return nil;
    mFilePathName = [ModrigUtils::StringFromPath(path) retain];
    mUnloadable = ModrigUtils::IsAppUnloadAble(path);
    return self;
}

- (void)dealloc
{
    [mFilePathName release];
    [mFileName release];
    [mFilePath release];
    [super dealloc];
}

// Where no other path was given, name and folder wait for the first who asks: few of many rows ever show.
- (NSString*)fileName
{
    if (!mFileName)
        mFileName = [[mFilePathName lastPathComponent] copy];
    return mFileName;
}

- (NSString*)filePath
{
    if (!mFilePath)
        mFilePath = [[mFilePathName stringByDeletingLastPathComponent] copy];
    return mFilePath;
}

- (CStdStr)path
{
    return CStdStr(NSStringToWstring(mFilePathName));
}

- (BOOL)isEqual:(id)other
{
    return
        [other isKindOfClass:[self class]] && ModrigUtils::AreSamePath(mFilePathName, [other filePathName]);
}

- (NSUInteger)hash
{
    const NSUInteger length = [mFilePathName length];
    std::u16string characters(length, u'\0');
    [mFilePathName getCharacters:reinterpret_cast<unichar*>(characters.data()) range:NSMakeRange(0, length)];
    return ModrigUtils::HashOfPath(characters);
}

@end
