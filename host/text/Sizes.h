// How large something is, as a person is told it.
#pragma once

#include <cstdint>
#include <string>

#include "host/text/Translation.h"

namespace tessel
{
// "32 MB", "64 kB", "100 bytes": the largest of these that it is a multiple of.
inline std::wstring sizeInWords(std::uintmax_t bytes)
{
    constexpr std::uintmax_t kThousand = 1024;
    if (bytes == 0 || bytes % kThousand != 0)
        return translatedByCount(static_cast<std::size_t>(bytes), L"{} bytes", L"{} bytes");
    bytes /= kThousand;
    return bytes % kThousand != 0 ? std::to_wstring(bytes) + L" kB"
                                  : std::to_wstring(bytes / kThousand) + L" MB";
}
} // namespace tessel
