// The content of a file that a person or another program has put there, and that may be anything.
#pragma once

#include <cstdint>
#include <filesystem>
#include <string>

#include <fcntl.h>
#include <sys/stat.h>

#include "host/platform/Descriptor.h"
#include "host/text/Result.h"

namespace tessel
{
// The code of a failure when nothing stands at the path at all.
inline constexpr int kNothingThere = 2;

// Whether an ordinary file stands at the path, links followed; no where the system cannot say.
bool isOrdinaryFile(const std::filesystem::path& path);

// Whether what the system says of a path is that an ordinary file stands there.
Result<> checkOrdinary(const struct stat& status);

// An ordinary file, open for reading, and what the system says of it. Neither a pipe nor a device is waited
// for: they are refused, as folders are. Why is the end of a sentence, as everywhere here.
Result<Descriptor> openOrdinaryFile(const std::filesystem::path& path, struct stat& status);

// What was opened with these flags, if it is one: opening a pipe that nobody writes to would wait for a
// writer.
inline constexpr int kToReadOrdinary = O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY;
Result<Descriptor> ordinaryFile(Descriptor opened, struct stat& status);

// All bytes of an ordinary file of at most that size.
Result<std::string> readOrdinaryFile(const std::filesystem::path& path, std::uintmax_t mostBytes);
} // namespace tessel
