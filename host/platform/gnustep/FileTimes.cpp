#include "host/platform/FileTimes.h"

#include <sys/stat.h>

namespace tessel
{
namespace
{
std::int64_t nanoseconds(const timespec& time)
{
    return std::int64_t{time.tv_sec} * 1'000'000'000 + time.tv_nsec;
}
} // namespace

std::int64_t contentTime(const struct stat& status)
{
    return nanoseconds(status.st_mtim);
}

std::int64_t statusTime(const struct stat& status)
{
    return nanoseconds(status.st_ctim);
}
} // namespace tessel
