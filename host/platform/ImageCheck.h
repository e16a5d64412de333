// A look at a shared library before the system maps it. The system's linker trusts the headers: a file that
// was cut short ends the process at the first touch of a page that is not there.
//
// The check reads headers only and costs a few microseconds. It vouches for what the headers say about the
// file's extent and layout, not for the code and data between them: a changed byte there cannot be seen.
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>

#include "host/text/Result.h"

namespace tessel
{
class RegularFile;

// Fills the buffer with bytes of the file from an offset; false when the file does not hold that many there.
using ReadAt = std::function<bool(std::uint64_t offset, void* buffer, std::size_t size)>;

// Reads that file, for as long as it is there.
ReadAt readerOf(const RegularFile& file);

// Whether the file may be mapped; why not is the end of a sentence.
Result<> checkMappable(std::uint64_t fileSize, const ReadAt& readAt);
// A file that is not open may not, for the reason (and its code) that it is not.
Result<> checkMappable(const RegularFile& file);
} // namespace tessel
