// The version of the SDK stands in a note, and notes are a segment of their own.
#include "host/applications/SdkVersion.h"

#include <algorithm>
#include <cstddef>
#include <cstring>

#include <link.h>
#include <tessel/tsversion.h>

namespace tessel
{
namespace
{
using Header = ElfW(Ehdr);
using Segment = ElfW(Phdr);
using Note = ElfW(Nhdr);

constexpr std::uint64_t kMostBytesOfNotes = 1 << 16; // linkers write some hundred

// What stands before the version.
constexpr std::size_t kNoteHead = sizeof(Note) + sizeof TSRX_SDK_NOTE_OWNER;
static_assert(offsetof(TsRxSdkNote, majorNumber) == kNoteHead);

std::uint64_t inWholeUnits(std::uint64_t size)
{
    constexpr std::uint64_t kUnit = 4;
    return (size + kUnit - 1) / kUnit * kUnit;
}

bool isVersion(const TsRxSdkNote& note)
{
    return note.ownerSize == sizeof note.owner && note.type == TSRX_SDK_NOTE_TYPE &&
           note.versionSize == sizeof note - kNoteHead &&
           std::memcmp(note.owner, TSRX_SDK_NOTE_OWNER, sizeof note.owner) == 0;
}

std::optional<SdkVersion> versionIn(const Segment& notes, const ReadAt& readAt)
{
    const std::uint64_t end = notes.p_offset + std::min<std::uint64_t>(notes.p_filesz, kMostBytesOfNotes);
    std::uint64_t place = notes.p_offset;
    TsRxSdkNote note = {};
    while (place < end && end - place >= sizeof note && readAt(place, &note, sizeof note))
    {
        if (isVersion(note))
            return SdkVersion{note.majorNumber, note.minorNumber};
        place += sizeof(Note) + inWholeUnits(note.ownerSize) + inWholeUnits(note.versionSize);
    }
    return std::nullopt;
}
} // namespace

std::optional<SdkVersion> sdkVersionIn(std::uint64_t, const ReadAt& readAt)
{
    Header header = {};
    if (!readAt(0, &header, sizeof header))
        return std::nullopt;
    for (std::uint64_t index = 0; index < header.e_phnum; ++index)
    {
        Segment segment = {};
        if (!readAt(header.e_phoff + index * sizeof segment, &segment, sizeof segment))
            return std::nullopt;
        if (segment.p_type != PT_NOTE)
            continue;
        if (const auto version = versionIn(segment, readAt))
            return version;
    }
    return std::nullopt;
}
} // namespace tessel
