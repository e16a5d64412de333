// Loaded in front of the system's libraries: replaces a file at the moment at which it is to be mapped.
// The environment says which: SWAP_FILE, and SWAP_WITH for what comes in its place. GROW_FILE names one that
// gets a further byte at that moment.
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fstream>

#include <dlfcn.h>

namespace
{
void swap(const char* path)
{
    const char* file = std::getenv("SWAP_FILE");
    const char* other = std::getenv("SWAP_WITH");
    if (file && other && path && std::strcmp(path, file) == 0 && std::rename(other, file) == 0)
        std::fputs("swapped\n", stderr);
}

void grow(const char* path)
{
    const char* file = std::getenv("GROW_FILE");
    if (file && path && std::strcmp(path, file) == 0)
        std::ofstream(file, std::ios::app) << 'x';
}
} // namespace

extern "C" __attribute__((visibility("default"))) void* dlopen(const char* path, int mode) noexcept
{
    if ((mode & RTLD_NOLOAD) == 0)
    {
        swap(path);
        grow(path);
    }
    const auto original = reinterpret_cast<void* (*)(const char*, int)>(dlsym(RTLD_NEXT, "dlopen"));
    return original(path, mode);
}
