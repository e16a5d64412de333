#include "host/platform/ImageCheck.h"

#include "host/platform/RegularFile.h"

namespace tessel
{
Result<> checkMappable(const RegularFile& file)
{
    if (!file.opened())
        return file.opened();
    return checkMappable(file.size(), [&](std::uint64_t offset, void* buffer, std::size_t size)
                         { return file.read(offset, buffer, size); });
}
} // namespace tessel
