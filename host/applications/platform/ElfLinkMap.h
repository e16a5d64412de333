// What the system's linker knows of a library.
#pragma once

#include <dlfcn.h>
#include <link.h>

namespace tessel
{
// Null where it tells nothing.
inline const link_map* linkMapOf(void* library)
{
    link_map* map = nullptr;
    return dlinfo(library, RTLD_DI_LINKMAP, &map) == 0 ? map : nullptr;
}
} // namespace tessel
