#include "host/platform/Bundle.h"

#import <Foundation/Foundation.h>
#include <wincompat/winstring.h>

#include <algorithm>
#include <cerrno>
#include <filesystem>

#include "host/platform/AutoreleasePool.h"
#include "host/platform/BundleDescription.h"
#include "host/platform/FileNames.h"
#include "host/platform/ObjectiveCGuard.h"
#include "host/platform/RealPath.h"
#include "host/platform/SystemFailure.h"
#include "host/text/Translation.h"
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

bool leadsInside(const std::filesystem::path& name)
{
    return name.is_relative() && std::find(name.begin(), name.end(), "..") == name.end();
}

Result<> checkProgramName(id name)
{
    if (!name)
        return {};
    if (![name isKindOfClass:[NSString class]])
        return Failure{translated(L"its description has no text for the name of its program")};
    if (leadsInside([name fileSystemRepresentation]))
        return {};
    return Failure{translated(L"its description names the program \"{}\", which leads out of the bundle",
                              NSStringToWstring(name))};
}

// By either name that the platforms have for it.
Result<> checkProgramNames(NSBundle* bundle)
{
    NSDictionary* description = [bundle infoDictionary];
    const auto checked = checkProgramName([description objectForKey:@"NSExecutable"]);
    return checked ? checkProgramName([description objectForKey:@"CFBundleExecutable"]) : checked;
}

Result<std::string> askForProgram(const std::string& folder)
{
    std::error_code failed;
    NSBundle* bundle = bundleAt(folder);
    const std::string bundleFolder = bundle ? [[bundle bundlePath] fileSystemRepresentation] : folder;
    if (!std::filesystem::equivalent(bundleFolder, folder, failed))
        // GNUstep answers with the bundle that it has opened before under the same identifier.
        return Failure{translated(L"the bundle \"{}\" has the same identifier", toWide(bundleFolder))};
    if (auto checked = checkProgramNames(bundle); !checked)
        return checked.failure();
    NSString* path = [bundle executablePath];
    if (!path)
        return Failure{translated(L"the bundle holds no program for this system")};
    const std::string program = [path fileSystemRepresentation];
    if (!std::filesystem::exists(program, failed))
        return Failure{translated(L"its program \"{}\" is missing", toWide(program))};
    const std::filesystem::path real = realPath(program);
    if (!isWithin(real.native(), realPath(folder).native()))
        return Failure{
            translated(L"its program \"{}\" leads out of the bundle, to \"{}\"", toWide(program), real)};
    return program;
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
        return systemFailure(failed ? failed.value() : ENOENT);
    if (!std::filesystem::is_directory(folder, failed))
        return Failure{translated(L"it is a file, and a bundle is a folder")};
    if (auto checked = checkDescription(folder); !checked)
        return checked.failure();
    Result<std::string> program = Failure{};
    const auto returned = catchObjectiveC([&] { program = askForProgram(folder); });
    return returned ? program : Failure{translated(L"the platform's bundles raised {}", returned.sentence())};
}

Result<> loadBundle(const std::string& folder)
{
    const AutoreleasePool pool;
    bool loaded = false;
    const auto returned = catchObjectiveC([&] { loaded = [bundleAt(folder) load] == YES; });
    if (!returned)
        return Failure{returned.sentence(), kBundleRaised};
    return loaded ? Result<>()
                  : Failure{translated(L"the platform does not accept it as a bundle"), kBundleNotAccepted};
}

Result<> unloadBundle(const std::string& folder)
{
    const AutoreleasePool pool;
    const auto returned = catchObjectiveC([&] { [bundleAt(folder) unload]; });
    return returned ? returned : Failure{returned.sentence(), kBundleRaised};
}
} // namespace tessel
