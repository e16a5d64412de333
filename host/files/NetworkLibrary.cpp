#include "host/files/NetworkLibrary.h"

#include <dlfcn.h>

#include "host/platform/ProductFolders.h"

namespace tessel
{
namespace
{
// The file's name on this platform, and what the linker knows it by.
constexpr char kNetworkLibrary[] = TESSEL_NETWORK_LIBRARY;
constexpr char kLinkedLibrary[] = TESSEL_LINKED_NETWORK_LIBRARY;
constexpr char kNetwork[] = "tesselNetwork";

// Beside the host's library; or where a program has it that is linked with the host's parts.
Network* mapNetwork()
{
    const auto beside = runningProductFolders().binaries / kNetworkLibrary;
    void* library = dlopen(beside.c_str(), RTLD_NOW | RTLD_LOCAL);
    if (!library)
        library = dlopen(kLinkedLibrary, RTLD_NOW | RTLD_LOCAL);
    const auto ask = library ? reinterpret_cast<Network* (*)()>(dlsym(library, kNetwork)) : nullptr;
    return ask ? ask() : nullptr;
}
} // namespace

Network* network()
{
    static Network* found = nullptr;
    if (!found) // it may only have been that no more files could be opened
        found = mapNetwork();
    return found;
}
} // namespace tessel
