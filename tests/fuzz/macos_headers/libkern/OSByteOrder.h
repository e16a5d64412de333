// What the check of Mach-O headers needs of the system's header, for machines that have none.
#pragma once

#include <cstdint>

inline std::uint32_t OSSwapBigToHostInt32(std::uint32_t number)
{
    return __builtin_bswap32(number);
}
