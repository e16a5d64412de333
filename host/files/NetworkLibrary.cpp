#include "host/files/NetworkLibrary.h"

#include <dlfcn.h>

#include <string>

#include "host/platform/ProductFolders.h"
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

// Beside the host's library; or where a program has it that is linked with the host's parts.
Result<Network*> mapNetwork()
{
    const auto beside = runningProductFolders().binaries / kNetworkLibrary;
    void* library = dlopen(beside.c_str(), RTLD_NOW | RTLD_LOCAL);
    const std::wstring reason = library ? std::wstring() : lastWordsOfLinker();
    if (!library)
        library = dlopen(kLinkedLibrary, RTLD_NOW | RTLD_LOCAL);
    if (!library)
        return Failure{translated(
            L"Tessel's library for the network cannot be used, and Tessel has to be installed again ({})",
            reason)};
    const auto ask = reinterpret_cast<NetworkOfVersion>(dlsym(library, kNetwork));
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
    auto mapped =
        mapNetwork(); // where it failed before, it may only have been that no more files could be opened
    if (mapped)
        found = *mapped;
    return mapped;
}
} // namespace tessel
