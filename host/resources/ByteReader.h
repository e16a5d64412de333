// Little-endian numbers out of bytes that nobody vouches for.
#pragma once

#include <cstddef>
#include <cstdint>
#include <span>

#include "host/text/Translation.h"

namespace tessel
{
// Thrown where the bytes contradict themselves. Whoever reads a file catches it.
struct DamagedFile
{
    Sentence<> why; // the end of one
};

class ByteReader
{
public:
    // `whyOutside`: what a position outside of the bytes means for the file.
    ByteReader(std::span<const std::uint8_t> bytes, Sentence<> whyOutside)
        : mBytes(bytes), mWhyOutside(whyOutside)
    {
    }

    std::size_t size() const { return mBytes.size(); }

    std::uint16_t u16(std::size_t offset) const
    {
        const auto two = part(offset, 2);
        return static_cast<std::uint16_t>(two[0] | two[1] << 8);
    }
    std::uint32_t u32(std::size_t offset) const
    {
        return u16(offset) | static_cast<std::uint32_t>(u16(offset + 2)) << 16;
    }
    std::span<const std::uint8_t> part(std::size_t offset, std::size_t size) const
    {
        if (size > mBytes.size() || offset > mBytes.size() - size)
            throw DamagedFile{mWhyOutside};
        return mBytes.subspan(offset, size);
    }

private:
    std::span<const std::uint8_t> mBytes;
    Sentence<> mWhyOutside;
};
} // namespace tessel
