// The check of a shared library's headers, for Mach-O. The system's loader on macOS examines a file's extent
// and signature by itself; here it is told in words what kind of file stands in its place, and what it has
// lost.
#include "host/platform/ImageCheck.h"

#include <libkern/OSByteOrder.h>
#include <mach-o/dyld.h>
#include <mach-o/fat.h>
#include <mach-o/loader.h>

#include "host/platform/ImageRefusal.h"
#include "host/platform/MachOFile.h"

namespace tessel
{
namespace
{
constexpr std::uint32_t kMostArchitectures = 32;

cpu_type_t ownProcessor()
{
    return _dyld_get_image_header(0)->cputype;
}

Result<> checkKind(const mach_header_64& header)
{
    if (header.magic != MH_MAGIC_64)
        return refusal::refused(refusal::kNoLibrary);
    if (header.cputype != ownProcessor())
        return refusal::refused(refusal::kOtherMachine);
    if (header.filetype == MH_EXECUTE)
        return refusal::refused(refusal::kIsProgram);
    return header.filetype == MH_BUNDLE || header.filetype == MH_DYLIB
               ? Result<>()
               : refusal::refused(refusal::kNoLibrary);
}

// Whether the file holds all that it says a segment has.
Result<> checkSegment(const MachOImage& image, std::uint64_t place, const ReadAt& readAt)
{
    segment_command_64 segment = {};
    if (!readAt(place, &segment, sizeof segment))
        return refusal::refused(refusal::kCutShort);
    if (segment.cmdsize < sizeof segment)
        return refusal::refused(refusal::kDamaged);
    const bool fits = segment.filesize <= image.size && segment.fileoff <= image.size - segment.filesize;
    return fits ? Result<>() : refusal::refused(refusal::kCutShort);
}

Result<> checkCommands(const MachOImage& image, const mach_header_64& header, const ReadAt& readAt)
{
    std::uint64_t place = image.start + sizeof header;
    std::uint64_t room = header.sizeofcmds;
    for (std::uint32_t left = header.ncmds; left > 0; --left)
    {
        load_command command = {};
        if (!readAt(place, &command, sizeof command))
            return refusal::refused(refusal::kCutShort);
        if (command.cmdsize < sizeof command || command.cmdsize > room)
            return refusal::refused(refusal::kDamaged);
        const auto checked = command.cmd == LC_SEGMENT_64 ? checkSegment(image, place, readAt) : Result<>();
        if (!checked)
            return checked;
        place += command.cmdsize;
        room -= command.cmdsize;
    }
    return {};
}

Result<> checkThin(const MachOImage& image, const ReadAt& readAt)
{
    mach_header_64 header = {};
    if (image.size < sizeof header || !readAt(image.start, &header, sizeof header))
        return refusal::refused(refusal::kCutShort);
    if (auto checked = checkKind(header); !checked)
        return checked;
    if (header.sizeofcmds > image.size - sizeof header)
        return refusal::refused(refusal::kCutShort);
    return checkCommands(image, header, readAt);
}

} // namespace

// A universal file: one image per processor, big-endian headers in front.
Result<MachOImage> imageForThisProcessor(std::uint64_t fileSize, const ReadAt& readAt)
{
    fat_header header = {};
    if (!readAt(0, &header.magic, sizeof header.magic))
        return refusal::refused(refusal::kNoLibrary);
    if (header.magic != FAT_CIGAM)
        return MachOImage{0, fileSize};
    if (!readAt(0, &header, sizeof header))
        return refusal::refused(refusal::kCutShort);
    const std::uint32_t count = OSSwapBigToHostInt32(header.nfat_arch);
    if (count > kMostArchitectures)
        return refusal::refused(refusal::kNoLibrary);
    for (std::uint32_t i = 0; i < count; ++i)
    {
        fat_arch image = {};
        if (!readAt(sizeof header + i * sizeof image, &image, sizeof image))
            return refusal::refused(refusal::kCutShort);
        if (static_cast<cpu_type_t>(OSSwapBigToHostInt32(static_cast<std::uint32_t>(image.cputype))) !=
            ownProcessor())
            continue;
        const std::uint64_t start = OSSwapBigToHostInt32(image.offset);
        const std::uint64_t size = OSSwapBigToHostInt32(image.size);
        if (size > fileSize || start > fileSize - size)
            return refusal::refused(refusal::kCutShort);
        return MachOImage{start, size};
    }
    return refusal::refused(refusal::kOtherMachine);
}

Result<> checkMappable(std::uint64_t fileSize, const ReadAt& readAt)
{
    const auto image = imageForThisProcessor(fileSize, readAt);
    return image ? checkThin(*image, readAt) : image.failure();
}
} // namespace tessel
