#include "host/files/NetworkLibrary.h"

#include <dlfcn.h>

#include <filesystem>
#include <string>

#include "host/platform/ImageCheck.h"
#include "host/platform/ProductFolders.h"
#include "host/platform/RegularFile.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"
#include "host/text/Version.h"

namespace tessel
{
namespace
{
// The file's name on this platform, and what the linker knows it by.
constexpr char kNetworkLibrary[] = TESSEL_NETWORK_LIBRARY;
constexpr char kLinkedLibrary[] = TESSEL_LINKED_NETWORK_LIBRARY;
constexpr char kNetwork[] = "tesselNetwork";

using NetworkOfVersion = Network* (*)(const char* version);

std::wstring lastWordsOfLinker()
{
    const char* words = dlerror();
    return toWide(words ? words : "");
}

// The one beside the host's library; or, where none is, the one that a program has which is linked with the
// host's parts. Why not is the reason alone.
Result<void*> openLibrary(const std::filesystem::path& beside)
{
    const auto mappable = checkMappable(RegularFile(beside.native()));
    if (mappable || mappable.code() == kNothingThere)
        if (void* library = dlopen(mappable ? beside.c_str() : kLinkedLibrary, RTLD_NOW | RTLD_LOCAL))
            return library;
    return Failure{mappable ? lastWordsOfLinker() : toWide(beside.native()) + L": " + mappable.sentence()};
}

Result<Network*> mapNetwork()
{
    const auto beside = runningProductFolders().binaries / kNetworkLibrary;
    const auto library = openLibrary(beside);
    if (!library)
        return Failure{translated(
            L"Tessel's library for the network cannot be used, and Tessel has to be installed again ({})",
            library.sentence())};
    const auto ask = reinterpret_cast<NetworkOfVersion>(dlsym(*library, kNetwork));
    Network* const found = ask ? ask(version().c_str()) : nullptr;
    if (!found)
        return Failure{translated(L"Tessel's library for the network is of another version, and Tessel has "
                                  L"to be started again ({})",
                                  beside)};
    return found;
}
} // namespace

Result<Network*> network()
{
    static Network* found = nullptr;
    if (found)
        return found;
    // Where it failed before, it may only have been that no more files could be opened.
    auto mapped = mapNetwork();
    if (mapped)
        found = *mapped;
    return mapped;
}
} // namespace tessel
