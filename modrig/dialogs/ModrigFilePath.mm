#import "modrig/dialogs/ModrigFilePath.h"

#include <wincompat/winstring.h>

#include <array>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "modrig/loader/LoadedApplications.h"

namespace
{
constexpr unichar kLastAscii = 0x7F;

// Nothing else is equal to these and their capitals without regard to case. Left out are the letters that
// something is: the s (long s), the k (Kelvin), those of ligatures.
constexpr std::string_view kUnmistakable = "0123456789/._-bcdeghmopqruvwxyz";

// The lower-case letter of each unmistakable character, and 0 of every other one.
constexpr auto kCertain = []
{
    std::array<char, kLastAscii + 1> certain = {};
    for (const char character : kUnmistakable)
    {
        certain[static_cast<std::size_t>(character)] = character;
        if (character >= 'a' && character <= 'z')
            certain[static_cast<std::size_t>(character - 'a' + 'A')] = character;
    }
    return certain;
}();
} // namespace

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
    const NSUInteger length = [mFilePathName length];
    std::vector<unichar> characters(length + 1); // nothing follows the last one
    [mFilePathName getCharacters:characters.data() range:NSMakeRange(0, length)];
    std::string certain;
    certain.reserve(length);
    for (NSUInteger index = 0; index < length; ++index)
        if (characters[index] <= kLastAscii && characters[index + 1] <= kLastAscii &&
            kCertain[characters[index]])
            certain += kCertain[characters[index]];
    return std::hash<std::string>()(certain);
}

@end
