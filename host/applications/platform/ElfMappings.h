// Which files stand behind the memory of the process, by the system's list of its mappings.
#pragma once

#include <optional>

#include "host/platform/RegularFile.h"

namespace tessel
{
// The file that the address is mapped from; nothing where nothing is mapped or the system does not tell, and
// zeros for memory of no file. Devices are not always those that files answer: with layered file systems they
// are others.
std::optional<FileIdentity> fileMappedAt(const void* address);

// The two ways to find out: asking about the one address, which costs the same however much is mapped but
// which older systems (Linux before 6.11) do not know; and reading the list, one entry after the other.
std::optional<FileIdentity> fileAskedFor(const void* address);
std::optional<FileIdentity> fileListedFor(const void* address);
} // namespace tessel
