// What the check of Mach-O headers needs of the system's header, for machines that have none.
#pragma once

#include <cstdint>

#include <mach-o/loader.h>

constexpr std::uint32_t FAT_CIGAM = 0xbebafeca;

struct fat_header
{
    std::uint32_t magic;
    std::uint32_t nfat_arch;
};

struct fat_arch
{
    cpu_type_t cputype;
    int cpusubtype;
    std::uint32_t offset;
    std::uint32_t size;
    std::uint32_t align;
};
