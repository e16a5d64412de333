// The check of a shared library's headers, for ELF.
#include "host/platform/ImageCheck.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstring>
#include <span>

#include <elf.h>
#include <link.h>

#include "host/platform/ImageRefusal.h"
#include "host/text/Translation.h"

// The host's own header, put there by the linker: what we load must be made for the same machine.
extern "C" const ElfW(Ehdr) __ehdr_start __attribute__((visibility("hidden")));

namespace tessel
{
namespace
{
using Header = ElfW(Ehdr);
using Segment = ElfW(Phdr);

constexpr std::size_t kMostSegments = 128;            // linkers write about a dozen
constexpr std::uint64_t kSmallestPageInMemory = 4096; // the smallest page that segments are laid out for

constexpr auto kObjectFile = Sentence(L"it is an object file, not a shared library");

bool fits(std::uint64_t offset, std::uint64_t size, std::uint64_t whole)
{
    return size <= whole && offset <= whole - size;
}

std::uint64_t pageStart(std::uint64_t address)
{
    return address & ~(kSmallestPageInMemory - 1);
}

std::uint64_t pageEnd(std::uint64_t address)
{
    return pageStart(address + kSmallestPageInMemory - 1);
}

Result<> checkKind(const Header& header)
{
    if (std::memcmp(header.e_ident, ELFMAG, SELFMAG) != 0)
        return refusal::refused(refusal::kNoLibrary);
    const bool sameMachine = header.e_ident[EI_CLASS] == __ehdr_start.e_ident[EI_CLASS] &&
                             header.e_ident[EI_DATA] == __ehdr_start.e_ident[EI_DATA] &&
                             header.e_machine == __ehdr_start.e_machine;
    if (!sameMachine)
        return refusal::refused(refusal::kOtherMachine);
    if (header.e_type == ET_EXEC)
        return refusal::refused(refusal::kIsProgram);
    if (header.e_type == ET_REL)
        return refusal::refused(kObjectFile);
    return header.e_type == ET_DYN ? Result<>() : refusal::refused(refusal::kNoLibrary);
}

Result<> checkHeaderTables(const Header& header, std::uint64_t fileSize)
{
    if (header.e_phentsize != sizeof(Segment) || header.e_phnum == 0 || header.e_phnum > kMostSegments)
        return refusal::refused(refusal::kDamaged);
    if (!fits(header.e_phoff, std::uint64_t{header.e_phnum} * sizeof(Segment), fileSize))
        return refusal::refused(refusal::kCutShort);
    // Sections are not mapped, but their table is the last thing in the file: where it is missing, the file
    // has lost its end.
    if (!fits(header.e_shoff, std::uint64_t{header.e_shnum} * header.e_shentsize, fileSize))
        return refusal::refused(refusal::kCutShort);
    return {};
}

Result<> checkLoadedSegment(const Segment& segment, std::uint64_t fileSize)
{
    if (!fits(segment.p_offset, segment.p_filesz, fileSize))
        return refusal::refused(refusal::kCutShort);
    const bool alignmentIsPower = (segment.p_align & (segment.p_align - 1)) == 0;
    const bool samePlaceInPage = (segment.p_vaddr - segment.p_offset) % kSmallestPageInMemory == 0;
    const bool endsInAddressSpace =
        segment.p_vaddr + segment.p_memsz + kSmallestPageInMemory > segment.p_vaddr;
    // Only what can be written has a part that the file does not hold.
    const bool sizesAgree = (segment.p_flags & PF_W) != 0 ? segment.p_filesz <= segment.p_memsz
                                                          : segment.p_filesz == segment.p_memsz;
    return alignmentIsPower && samePlaceInPage && endsInAddressSpace && sizesAgree
               ? Result<>()
               : refusal::refused(refusal::kDamaged);
}

// How far a segment's addresses lie past its place in the file.
std::uint64_t shiftOf(const Segment& segment)
{
    return segment.p_vaddr - segment.p_offset;
}

// Linkers leave no more room before a segment than its alignment asks for, and what the one before it has
// that the file does not hold: one farther away has been moved, and what is written there ends the host.
bool isNear(const Segment& segment, const Segment& previous)
{
    const std::uint64_t room = std::max<std::uint64_t>(segment.p_align, kSmallestPageInMemory) +
                               pageEnd(previous.p_memsz - previous.p_filesz);
    return static_cast<std::int64_t>(shiftOf(segment) - shiftOf(previous)) <= static_cast<std::int64_t>(room);
}

// The system maps each segment over what stands at its addresses, so they have to follow one another, on
// pages of their own.
bool follows(const Segment& segment, const Segment& previous)
{
    return pageStart(segment.p_vaddr) >= pageEnd(previous.p_vaddr + previous.p_memsz) &&
           segment.p_offset >= previous.p_offset + previous.p_filesz && isNear(segment, previous);
}

Result<> checkLoadedSegments(std::span<const Segment> segments, std::uint64_t fileSize)
{
    const Segment* previous = nullptr;
    bool hasCode = false;
    for (const Segment& segment : segments)
    {
        if (segment.p_type != PT_LOAD)
            continue;
        if (auto checked = checkLoadedSegment(segment, fileSize); !checked)
            return checked;
        if (previous && !follows(segment, *previous))
            return refusal::refused(refusal::kDamaged);
        previous = &segment;
        hasCode |= (segment.p_flags & PF_X) != 0;
    }
    return hasCode ? Result<>() : refusal::refused(refusal::kDamaged);
}

bool holds(const Segment& loaded, const Segment& part)
{
    return loaded.p_type == PT_LOAD && part.p_vaddr >= loaded.p_vaddr &&
           part.p_vaddr - loaded.p_vaddr < loaded.p_memsz;
}

bool takesNoRoom(const Segment& part)
{
    const bool onlyZeroed = part.p_type == PT_TLS && part.p_filesz == 0;
    return part.p_type == PT_LOAD || part.p_type == PT_NULL || part.p_type == PT_GNU_STACK ||
           part.p_memsz == 0 || onlyZeroed;
}

// The system reads these at their addresses, and finds there what the file holds at their offsets.
bool liesIn(const Segment& part, const Segment& loaded)
{
    const std::uint64_t distance = part.p_vaddr - loaded.p_vaddr;
    // Zeroed thread-local data takes no room among the loaded data.
    const std::uint64_t size = part.p_type == PT_TLS ? part.p_filesz : part.p_memsz;
    const bool writable = (loaded.p_flags & PF_W) != 0 || (part.p_flags & PF_W) == 0;
    return part.p_offset - loaded.p_offset == distance && part.p_filesz <= part.p_memsz && writable &&
           fits(distance, size, pageEnd(loaded.p_vaddr + loaded.p_memsz) - loaded.p_vaddr) &&
           fits(distance, part.p_filesz, loaded.p_filesz);
}

bool isSoundPart(const Segment& part, std::span<const Segment> segments)
{
    if (takesNoRoom(part))
        return true;
    const auto loaded =
        std::ranges::find_if(segments, [&](const Segment& segment) { return holds(segment, part); });
    return loaded != segments.end() && liesIn(part, *loaded);
}

Result<> checkSegments(std::span<const Segment> segments, std::uint64_t fileSize)
{
    const auto count = [&](std::uint32_t type)
    {
        return std::ranges::count(segments, type, &Segment::p_type);
    };
    if (count(PT_INTERP) > 0)
        return refusal::refused(refusal::kIsProgram);
    if (auto checked = checkLoadedSegments(segments, fileSize); !checked)
        return checked;
    const bool partsAreSound =
        std::ranges::all_of(segments, [&](const Segment& part) { return isSoundPart(part, segments); });
    return partsAreSound && count(PT_DYNAMIC) == 1 ? Result<>() : refusal::refused(refusal::kDamaged);
}

// A file too short for a header may still show what it was meant to be.
Result<> checkShortFile(std::uint64_t fileSize, const ReadAt& readAt)
{
    std::array<unsigned char, SELFMAG> start = {};
    const bool wasElf = readAt(0, start.data(), std::min<std::uint64_t>(fileSize, start.size())) &&
                        std::memcmp(start.data(), ELFMAG, start.size()) == 0;
    return refusal::refused(wasElf ? refusal::kCutShort : refusal::kNoLibrary);
}
} // namespace

Result<> checkMappable(std::uint64_t fileSize, const ReadAt& readAt)
{
    Header header = {};
    if (!readAt(0, &header, sizeof header))
        return checkShortFile(fileSize, readAt);
    if (auto checked = checkKind(header); !checked)
        return checked;
    if (auto checked = checkHeaderTables(header, fileSize); !checked)
        return checked;
    std::array<Segment, kMostSegments> table;
    if (!readAt(header.e_phoff, table.data(), header.e_phnum * sizeof(Segment)))
        return refusal::refused(refusal::kCutShort);
    return checkSegments(std::span(table).first(header.e_phnum), fileSize);
}
} // namespace tessel
