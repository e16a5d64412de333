// The check of a shared library's headers, for Mach-O. The system's loader on macOS examines a file's extent
// and signature by itself; here it is told in words what kind of file stands in its place.
#include "host/applications/ImageCheck.h"

#include <libkern/OSByteOrder.h>
#include <mach-o/dyld.h>
#include <mach-o/fat.h>
#include <mach-o/loader.h>

#include "host/applications/platform/MachOFile.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
constexpr std::uint32_t kMostArchitectures = 32;

constexpr auto kNoLibrary = Sentence(L"it is not a shared library");
constexpr auto kProgram = Sentence(L"it is a program, not a shared library");
constexpr auto kOtherMachine = Sentence(L"it is built for another kind of processor");
constexpr auto kCutShort = Sentence(L"the file is cut short");

Failure refused(Sentence<> reason)
{
    return {translated(reason)};
}

cpu_type_t ownProcessor()
{
    return _dyld_get_image_header(0)->cputype;
}

Result<> checkThin(std::uint64_t start, std::uint64_t size, const ReadAt& readAt)
{
    mach_header_64 header = {};
    if (size < sizeof header || !readAt(start, &header, sizeof header))
        return refused(kCutShort);
    if (header.magic != MH_MAGIC_64)
        return refused(kNoLibrary);
    if (header.cputype != ownProcessor())
        return refused(kOtherMachine);
    if (header.filetype == MH_EXECUTE)
        return refused(kProgram);
    if (header.filetype != MH_BUNDLE && header.filetype != MH_DYLIB)
        return refused(kNoLibrary);
    return header.sizeofcmds <= size - sizeof header ? Result<>() : refused(kCutShort);
}

} // namespace

// A universal file: one image per processor, big-endian headers in front.
Result<MachOImage> imageForThisProcessor(std::uint64_t fileSize, const ReadAt& readAt)
{
    fat_header header = {};
    if (!readAt(0, &header.magic, sizeof header.magic))
        return refused(kNoLibrary);
    if (header.magic != FAT_CIGAM)
        return MachOImage{0, fileSize};
    if (!readAt(0, &header, sizeof header))
        return refused(kCutShort);
    const std::uint32_t count = OSSwapBigToHostInt32(header.nfat_arch);
    if (count > kMostArchitectures)
        return refused(kNoLibrary);
    for (std::uint32_t i = 0; i < count; ++i)
    {
        fat_arch image = {};
        if (!readAt(sizeof header + i * sizeof image, &image, sizeof image))
            return refused(kCutShort);
        if (static_cast<cpu_type_t>(OSSwapBigToHostInt32(static_cast<std::uint32_t>(image.cputype))) !=
            ownProcessor())
            continue;
        const std::uint64_t start = OSSwapBigToHostInt32(image.offset);
        const std::uint64_t size = OSSwapBigToHostInt32(image.size);
        if (size > fileSize || start > fileSize - size)
            return refused(kCutShort);
        return MachOImage{start, size};
    }
    return refused(kOtherMachine);
}

Result<> checkMappable(std::uint64_t fileSize, const ReadAt& readAt)
{
    const auto image = imageForThisProcessor(fileSize, readAt);
    return image ? checkThin(image->start, image->size, readAt) : image.failure();
}
} // namespace tessel
