#include "host/platform/ImageCheck.h"

#include "host/platform/RegularFile.h"

namespace tessel
{
ReadAt readerOf(const RegularFile& file)
{
    return [&file](std::uint64_t offset, void* buffer, std::size_t size)
    {
        return file.read(offset, buffer, size);
    };
}

Result<> checkMappable(const RegularFile& file)
{
    return file.opened() ? checkMappable(file.size(), readerOf(file)) : file.opened();
}
} // namespace tessel
