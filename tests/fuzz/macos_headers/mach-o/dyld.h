// What the check of Mach-O headers needs of the system's header, for machines that have none: the program
// that is running is one for this processor.
#pragma once

#include <cstdint>

#include <mach-o/loader.h>

inline const mach_header* _dyld_get_image_header(std::uint32_t)
{
    static const mach_header program = {MH_MAGIC_64, CPU_TYPE_X86_64, 3, MH_EXECUTE, 0, 0, 0};
    return &program;
}
