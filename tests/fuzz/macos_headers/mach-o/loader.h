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

constexpr std::uint32_t LC_SEGMENT_64 = 0x19;

struct load_command
{
    std::uint32_t cmd;
    std::uint32_t cmdsize;
};

struct segment_command_64
{
    std::uint32_t cmd;
    std::uint32_t cmdsize;
    char segname[16];
    std::uint64_t vmaddr;
    std::uint64_t vmsize;
    std::uint64_t fileoff;
    std::uint64_t filesize;
    int maxprot;
    int initprot;
    std::uint32_t nsects;
    std::uint32_t flags;
};

struct section_64
{
    char sectname[16];
    char segname[16];
    std::uint64_t addr;
    std::uint64_t size;
    std::uint32_t offset;
    std::uint32_t align;
    std::uint32_t reloff;
    std::uint32_t nreloc;
    std::uint32_t flags;
    std::uint32_t reserved1;
    std::uint32_t reserved2;
    std::uint32_t reserved3;
};
