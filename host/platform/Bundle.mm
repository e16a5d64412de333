#include "host/platform/Bundle.h"

#import <Foundation/Foundation.h>
#include <wincompat/winstring.h>

#include <algorithm>
#include <cerrno>
#include <filesystem>

#include "host/platform/AutoreleasePool.h"
#include "host/platform/FileNames.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr std::string_view kBundleSuffix = ".bundle";

NSBundle* bundleAt(const std::string& folder)
{
    nameEveryFile();
    return [NSBundle bundleWithPath:wcharToNSString(toWide(folder).c_str())];
}

char lowerAscii(char character)
{
    return character >= 'A' && character <= 'Z' ? static_cast<char>(character - 'A' + 'a') : character;
}
} // namespace

bool isBundlePath(std::string_view path)
{
    if (path.size() < kBundleSuffix.size())
        return false;
    return std::ranges::equal(path.substr(path.size() - kBundleSuffix.size()), kBundleSuffix, {}, lowerAscii);
}

Result<std::string> programOfBundle(const std::string& folder)
{
    const AutoreleasePool pool;
    std::error_code failed;
    if (!std::filesystem::exists(folder, failed))
        return Failure{toWide(std::generic_category().message(failed ? failed.value() : ENOENT))};
    NSBundle* bundle = bundleAt(folder);
    if (bundle &&
        !std::filesystem::equivalent([[bundle bundlePath] fileSystemRepresentation], folder, failed))
        // GNUstep answers with the bundle that it has opened before under the same identifier.
        return Failure{L"the bundle \"" + NSStringToWstring([bundle bundlePath]) +
                       L"\" has the same identifier"};
    NSString* program = [bundle executablePath];
    if (!program)
        return Failure{L"the bundle holds no program for this system"};
    return std::string([program fileSystemRepresentation]);
}

bool loadBundle(const std::string& folder)
{
    const AutoreleasePool pool;
    return [bundleAt(folder) load] == YES;
}

void unloadBundle(const std::string& folder)
{
    const AutoreleasePool pool;
    [bundleAt(folder) unload];
}
} // namespace tessel
