// To the second: the finer times have names here that no other system has, and nothing depends on them.
#include "host/platform/FileTimes.h"

#include <sys/stat.h>

namespace tessel
{
namespace
{
constexpr std::int64_t kNanoseconds = 1'000'000'000;
}

std::int64_t contentTime(const struct stat& status)
{
    return std::int64_t{status.st_mtime} * kNanoseconds;
}

std::int64_t statusTime(const struct stat& status)
{
    return std::int64_t{status.st_ctime} * kNanoseconds;
}
} // namespace tessel
