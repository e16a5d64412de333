// Which file a library in memory comes from.
#pragma once

namespace tessel
{
// Whether the mapped library is the file behind the descriptor, on the same device and with the same inode;
// true where the system does not tell.
bool isMappedFrom(void* library, int descriptor);
} // namespace tessel
