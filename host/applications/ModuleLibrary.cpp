#include "host/applications/ModuleLibrary.h"

#include <utility>

#include <dlfcn.h>

#include "host/applications/ExceptionGuard.h"
#include "host/applications/LinkersWords.h"
#include "host/applications/platform/MappedImage.h"
#include "host/applications/platform/ObjectiveCRuntime.h"
#include "host/platform/Bundle.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr const char* kEntryPointName = "tsrxEntryPoint";
constexpr std::string_view kUndefinedSymbol = "undefined symbol: "; // how the linker says it

// The linker begins with the path, which the sentence around its words names already.
std::wstring linkersWords(const std::string& program)
{
    const char* error = dlerror();
    if (!error)
        return translated(L"the system does not say why");
    const std::string words = error;
    const std::string start = program + ": ";
    const std::string readable =
        withReadableSymbols(words.starts_with(start) ? words.substr(start.size()) : words);
    if (readable.starts_with(kUndefinedSymbol))
        return translated(L"undefined symbol: {}", toWide(readable.substr(kUndefinedSymbol.size())));
    return toWide(readable);
}

// The system's headers declare that these never throw, so the compiler leaves out what an exception needs to
// pass a call of them. But they run the library's own code, which may throw. Called through a volatile
// pointer, they are any functions to the compiler.
void* (*volatile const openLibrary)(const char* path, int mode) = dlopen;
int (*volatile const closeLibrary)(void* library) = dlclose;

void* map(const std::string& program, bool resolveNow)
{
    return openLibrary(program.c_str(), (resolveNow ? RTLD_NOW : RTLD_LAZY) | RTLD_LOCAL);
}

Failure threwInMapping(const std::wstring& what)
{
    return {translated(L"while it was being mapped, its code threw {}", what), ModuleLibrary::kThrew};
}

// A handle of its own for a library that is mapped, or null.
void* mappedLibrary(const std::string& program)
{
    return dlopen(program.c_str(), RTLD_NOLOAD | RTLD_LAZY);
}
} // namespace

Result<ModuleFile> moduleFileAt(std::string path)
{
    ModuleFile file;
    file.isBundle = isBundlePath(path);
    const auto program = file.isBundle ? programOfBundle(path) : Result<std::string>(path);
    if (!program)
        return program.failure();
    file.program = *program;
    file.path = std::move(path);
    return file;
}

ModuleLibrary::ModuleLibrary(ModuleFile file, void* handle, bool byPlatform)
    : mFile(std::move(file)), mHandle(handle), mByPlatform(byPlatform)
{
}

Result<std::unique_ptr<ModuleLibrary>> ModuleLibrary::open(const ModuleFile& file, bool resolveNow)
{
    Result<std::unique_ptr<ModuleLibrary>> library = Failure{};
    const auto returned = catchAnything([&] { library = openUnguarded(file, resolveNow); });
    return returned ? std::move(library) : threwInMapping(returned.sentence());
}

Result<std::unique_ptr<ModuleLibrary>> ModuleLibrary::openUnguarded(const ModuleFile& file, bool resolveNow)
{
    if (file.isBundle && needsBundleLoading(file.program))
        return openBundle(file, resolveNow);
    if (void* handle = map(file.program, resolveNow))
        return std::unique_ptr<ModuleLibrary>(new ModuleLibrary(file, handle, false));
    return Failure{linkersWords(file.program)};
}

Result<std::unique_ptr<ModuleLibrary>> ModuleLibrary::openBundle(const ModuleFile& file, bool resolveNow)
{
    const auto loaded = loadBundle(file.path);
    // Where the platform keeps the reason to itself, the system's linker has the same one.
    if (loaded.code() == kBundleNotAccepted && !map(file.program, true))
        return Failure{linkersWords(file.program)};
    if (loaded.code() == kBundleRaised)
        return threwInMapping(translated(L"an exception: {}", loaded.sentence()));
    if (!loaded)
        return loaded.failure();
    void* handle = mappedLibrary(file.program);
    if (!handle)
        return Failure{translated(L"the platform has loaded another program in its place")};
    if (const std::string missing = resolveNow ? firstUnresolvedFunction(handle) : ""; !missing.empty())
        return Failure{translated(L"undefined symbol: {}", toWide(withReadableSymbols(missing)))};
    return std::unique_ptr<ModuleLibrary>(new ModuleLibrary(file, handle, true));
}

bool ModuleLibrary::isFrom(const RegularFile& program) const
{
    return isMappedFrom(mHandle, program) && program.keepsItsSize();
}

TsRxEntryPoint ModuleLibrary::entryPoint() const
{
    return reinterpret_cast<TsRxEntryPoint>(dlsym(mHandle, kEntryPointName));
}

bool ModuleLibrary::close()
{
    const bool released = !mByPlatform || unloadBundle(mFile.path);
    if (!released || mustStayMapped(mHandle))
        return false;
    const void* address = addressIn(mHandle);
    bool closed = false;
    const auto returned = catchAnything([&] { closed = closeLibrary(mHandle) == 0; });
    return returned && closed && !(address && isInLibrary(address));
}
} // namespace tessel
