// What the check of Mach-O headers needs of the system's header, for machines that have none.
#pragma once

#include <cstdint>

using cpu_type_t = int;

constexpr cpu_type_t CPU_TYPE_X86_64 = 0x01000007;

constexpr std::uint32_t MH_MAGIC_64 = 0xfeedfacf;
constexpr std::uint32_t MH_EXECUTE = 2;
constexpr std::uint32_t MH_DYLIB = 6;
constexpr std::uint32_t MH_BUNDLE = 8;

struct mach_header
{
    std::uint32_t magic;
    cpu_type_t cputype;
    int cpusubtype;
    std::uint32_t filetype;
    std::uint32_t ncmds;
    std::uint32_t sizeofcmds;
    std::uint32_t flags;
};

struct mach_header_64 : mach_header
{
    std::uint32_t reserved;
};
