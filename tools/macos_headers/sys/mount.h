// What host/platform/cocoa uses of the system's file systems: declarations enough for compiling it elsewhere.
#pragma once

#include <cstdint>

#define MNT_LOCAL 0x00001000

struct statfs
{
    std::uint32_t f_flags;
};
extern "C" int statfs(const char* path, struct statfs* system);
