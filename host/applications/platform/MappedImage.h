// Which file a library in memory comes from, and whether it is still there.
#pragma once

namespace tessel
{
class RegularFile;

// Whether the mapped library is that open file, on the same device and with the same inode; true where the
// system does not tell.
bool isMappedFrom(void* library, const RegularFile& file);

// An address in the mapped library; null where the system does not tell one.
const void* addressIn(void* library);

// Whether a mapped library has that address now.
bool isInLibrary(const void* address);
} // namespace tessel
