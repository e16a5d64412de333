// Facts by which an application's file is recognised: whether it is still the same one.
//
// For a bundle these are facts about everything in it. Nothing is opened but for the hash.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

namespace tessel
{
struct FileFacts
{
    std::uint64_t size = 0;
    std::int64_t contentTime = 0; // nanoseconds of the calendar; so is the next
    std::int64_t statusTime = 0;
    std::uint64_t inode = 0;

    // A build that sets the times of its files may make another file of the same size and time.
    bool mayBeTheSame(const FileFacts& other) const
    {
        return size == other.size && contentTime == other.contentTime;
    }
    // Nobody has touched it.
    bool operator==(const FileFacts&) const = default;
};

// Nothing when there is no such file.
std::optional<FileFacts> factsOf(const std::string& path);

// Of the content; reads all of it. Nothing when it cannot be read.
std::optional<std::uint64_t> contentHash(const std::string& path);
} // namespace tessel
