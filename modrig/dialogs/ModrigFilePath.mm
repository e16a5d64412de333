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
    if (!(self = [self initWithResolvedPath:path]) || !path)
        return self;
    mFileName = [[path lastPathComponent] copy];
    mFilePath = [[path stringByDeletingLastPathComponent] copy];
    [mFilePathName release];
    mFilePathName = [[path stringByResolvingSymlinksInPath] copy];
    return self;
}

- (id)initWithResolvedPath:(NSString*)path
{
    if (!(self = [super init]) || !path)
        return self;
    mFilePathName = [path copy];
    mUnloadable = [self findUnloadable:CStdStr(NSStringToWstring(path))];
    return self;
}

- (BOOL)findUnloadable:(const CStdStr&)path
{
    return ModrigUtils::IsAppUnloadAble(path);
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
