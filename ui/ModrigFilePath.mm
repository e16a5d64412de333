#import "ui/ModrigFilePath.h"

#include <wincompat/winstring.h>

#include <cctype>
#include <functional>
#include <string>
#include <string_view>

#include "loader/LoadedApplications.h"

namespace
{
// Nothing else is equal to these and their capitals without regard to case. Left out are the letters that
// something is: the s (long s), the k (Kelvin), those of ligatures.
constexpr std::string_view kUnmistakable = "0123456789/._-bcdeghmopqruvwxyz";
constexpr unichar kLastAscii = 0x7F;

bool isUnmistakable(unichar character)
{
    const int lower = character <= kLastAscii ? std::tolower(character) : 0;
    return kUnmistakable.find(static_cast<char>(lower)) != std::string_view::npos;
}
} // namespace

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

// Paths that are equal may differ in more than their letters' case: an accent can be a character of its own,
// behind its letter, or part of it. So a letter counts only where no such character follows.
- (NSUInteger)hash
{
    std::string certain;
    const NSUInteger length = [mFilePathName length];
    for (NSUInteger index = 0; index < length; ++index)
    {
        const unichar character = [mFilePathName characterAtIndex:index];
        const bool standsAlone =
            index + 1 == length || [mFilePathName characterAtIndex:index + 1] <= kLastAscii;
        if (standsAlone && isUnmistakable(character))
            certain += static_cast<char>(std::tolower(character));
    }
    return std::hash<std::string>()(certain);
}

@end
