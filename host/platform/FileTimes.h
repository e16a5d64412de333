// The times of a file, in nanoseconds of the calendar; some systems tell whole seconds only.
#pragma once

#include <cstdint>

struct stat;

namespace tessel
{
// When its content changed; anybody can set it.
std::int64_t contentTime(const struct stat& status);
// When anything about it changed; nobody can set it.
std::int64_t statusTime(const struct stat& status);
} // namespace tessel
