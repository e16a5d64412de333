#include "host/registry/RowChecksum.h"

#include <zlib.h>

#include <cstring>
#include <utility>

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
        mSum = crc32_z(mSum, static_cast<const Bytef*>(bytes), count);
        return;
    }
    if (count > 0)
        std::memcpy(mGathered.data() + mCount, bytes, count);
    mCount += count;
}

// The sum of nothing is 0, with which it begins.
void RowChecksum::sumUp()
{
    mSum = crc32_z(mSum, mGathered.data(), std::exchange(mCount, 0));
}
} // namespace tessel
