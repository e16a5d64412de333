// The content of a file that a person or another program has put there, and that may be anything.
#pragma once

#include <cstdint>
#include <filesystem>
#include <string>

#include "host/text/Result.h"

namespace tessel
{
// The code of a failure when nothing stands at the path at all.
inline constexpr int kNothingThere = 2;

// All bytes of an ordinary file of at most that size. Neither a pipe nor a device is waited for: they are
// refused, as folders are. Why is the end of a sentence.
Result<std::string> readOrdinaryFile(const std::filesystem::path& path, std::uintmax_t mostBytes);
} // namespace tessel
