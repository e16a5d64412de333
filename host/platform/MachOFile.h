// Where in a file the image for this processor stands: a universal file has one for each.
#pragma once

#include <cstdint>

#include "host/platform/ImageCheck.h"

namespace tessel
{
struct MachOImage
{
    std::uint64_t start = 0;
    std::uint64_t size = 0;
};

// Why there is none is the end of a sentence.
Result<MachOImage> imageForThisProcessor(std::uint64_t fileSize, const ReadAt& readAt);
} // namespace tessel
