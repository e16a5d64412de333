// The version of the SDK stands in a section of its own.
#include "host/applications/SdkVersion.h"

#include <algorithm>
#include <cstring>

#include <mach-o/loader.h>
#include <tessel/tsversion.h>

#include "host/platform/MachOFile.h"

namespace tessel
{
namespace
{
constexpr char kSegment[] = "__TEXT";
constexpr char kSection[] = "__tessel_sdk";

template <std::size_t Size>
bool isNamed(const char (&name)[Size], const char* wanted)
{
    return std::strncmp(name, wanted, Size) == 0;
}

std::optional<SdkVersion> versionAt(std::uint64_t place, const ReadAt& readAt)
{
    TsRxSdkNote note = {};
    const bool isThere = readAt(place, &note, sizeof note) && note.type == TSRX_SDK_NOTE_TYPE &&
                         std::memcmp(note.owner, TSRX_SDK_NOTE_OWNER, sizeof note.owner) == 0;
    return isThere ? std::optional(SdkVersion{note.majorNumber, note.minorNumber}) : std::nullopt;
}

// In the sections that follow a segment's command.
std::optional<SdkVersion> versionIn(std::uint64_t start, std::uint64_t command, const ReadAt& readAt)
{
    segment_command_64 segment = {};
    if (!readAt(command, &segment, sizeof segment) || !isNamed(segment.segname, kSegment))
        return std::nullopt;
    const std::uint64_t room = std::max<std::uint64_t>(segment.cmdsize, sizeof segment) - sizeof segment;
    for (std::uint64_t index = 0; index < std::min<std::uint64_t>(segment.nsects, room / sizeof(section_64));
         ++index)
    {
        section_64 section = {};
        if (!readAt(command + sizeof segment + index * sizeof section, &section, sizeof section))
            return std::nullopt;
        if (isNamed(section.sectname, kSection))
            return versionAt(start + section.offset, readAt);
    }
    return std::nullopt;
}
} // namespace

std::optional<SdkVersion> sdkVersionIn(std::uint64_t fileSize, const ReadAt& readAt)
{
    const auto image = imageForThisProcessor(fileSize, readAt);
    mach_header_64 header = {};
    if (!image || !readAt(image->start, &header, sizeof header))
        return std::nullopt;
    std::uint64_t place = image->start + sizeof header;
    const std::uint64_t end = place + header.sizeofcmds;
    load_command command = {};
    while (place < end && readAt(place, &command, sizeof command) && command.cmdsize >= sizeof command)
    {
        if (command.cmd == LC_SEGMENT_64)
            if (const auto version = versionIn(image->start, place, readAt))
                return version;
        place += command.cmdsize;
    }
    return std::nullopt;
}
} // namespace tessel
