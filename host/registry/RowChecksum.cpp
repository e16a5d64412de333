#include "host/registry/RowChecksum.h"

#include <cstring>
#include <utility>

#include <libdeflate.h>

namespace tessel
{
std::int64_t RowChecksum::finish()
{
    sumUp();
    return static_cast<std::int64_t>(mSum);
}

void RowChecksum::addBytes(const void* bytes, std::size_t count)
{
    if (count > mGathered.size() - mCount)
        sumUp();
    if (count > mGathered.size())
    {
        mSum = libdeflate_crc32(mSum, bytes, count);
        return;
    }
    if (count > 0)
        std::memcpy(mGathered.data() + mCount, bytes, count);
    mCount += count;
}

// The sum of nothing is 0, with which it begins.
void RowChecksum::sumUp()
{
    mSum = libdeflate_crc32(mSum, mGathered.data(), std::exchange(mCount, 0));
}
} // namespace tessel
