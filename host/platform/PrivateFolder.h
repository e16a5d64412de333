// Folders and files that are the person's own.
#pragma once

#include <filesystem>

#include <sys/types.h>

#include "host/text/Result.h"

namespace tessel
{
// The rights of a file that only the person may read and write.
inline constexpr mode_t kOwnersOnly = 0600;

// Makes the folder so that only the person can enter it, and the missing ones above it as is usual. One that
// is there already stays as it is. Why it cannot be made is the end of a sentence.
Result<> makePrivateFolder(const std::filesystem::path& folder);

// The code where it belongs to somebody else, who alone can change that.
inline constexpr int kBelongsToAnother = 2;

// Fails where another user could have written: what stands at the path belongs to somebody else, or others
// have the right. Who and how is the end of a sentence. A link counts as what it leads to.
Result<> checkNobodyElseWrites(const std::filesystem::path& path);

// Whether this process may reach what is in the folder; what is no folder counts as such.
bool mayBeEntered(const std::filesystem::path& folder);

// Whether another user may reach what is in the folder.
bool othersMayEnter(const std::filesystem::path& folder);
} // namespace tessel
