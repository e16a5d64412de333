#import "modrig/dialogs/ModrigFilePath.h"

#include <objc/runtime.h>

#include <wincompat/winstring.h>

#include <algorithm>
#include <string>
#include <string_view>

#include "modrig/dialogs/Paths.h"
#include "modrig/dialogs/model/PathHash.h"
#include "modrig/loader/LoadedApplications.h"

namespace
{
char* charactersAfter(ModrigFilePath* row)
{
    return static_cast<char*>(object_getIndexedIvars(row));
}
} // namespace

@implementation ModrigFilePath

@synthesize unloadable = mUnloadable;

- (id)initWithFilePathName:(NSString*)path
{
    if (!(self = [super init]) || !path)
        return self;
    mFilePathName = [[path stringByResolvingSymlinksInPath] copy];
    mFileName = [[path lastPathComponent] copy];
    mFilePath = [[path stringByDeletingLastPathComponent] copy];
    mUnloadable = [self findUnloadable:ModrigUtils::PathFromString(path)];
    return self;
}

+ (ModrigFilePath*)newWithResolvedPath:(const CStdStr&)path
{
    const std::wstring& text = path.Text();
    const bool plain = ModrigUtils::IsAscii(text);
    auto* row = (ModrigFilePath*)[NSAllocateObject(self, plain ? text.size() + 1 : 0, nullptr) init];
    row->mIsPlain = plain;
    if (plain) // the memory is all zeros: there is one after them
        std::copy(text.begin(), text.end(), charactersAfter(row));
    else
        row->mFilePathName = [ModrigUtils::StringFromPath(path) retain];
    row->mUnloadable = [row findUnloadable:path];
    return row;
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

- (NSString*)filePathName
{
    if (!mFilePathName && mIsPlain)
        mFilePathName = [[NSString alloc] initWithUTF8String:charactersAfter(self)];
    return mFilePathName;
}

- (NSString*)fileName
{
    if (!mFileName)
        mFileName = [[[self filePathName] lastPathComponent] copy];
    return mFileName;
}

- (NSString*)filePath
{
    if (!mFilePath)
        mFilePath = [[[self filePathName] stringByDeletingLastPathComponent] copy];
    return mFilePath;
}

- (CStdStr)path
{
    if (!mIsPlain)
        return CStdStr(NSStringToWstring(mFilePathName));
    const std::string_view characters = charactersAfter(self);
    return CStdStr(std::wstring(characters.begin(), characters.end()));
}

- (BOOL)isEqual:(id)other
{
    return [other isKindOfClass:[self class]] &&
           ModrigUtils::AreSamePath([self filePathName], [other filePathName]);
}

- (NSUInteger)hash
{
    return ModrigUtils::HashOfPath([self path].Text());
}

@end
