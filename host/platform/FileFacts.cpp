#include "host/platform/FileFacts.h"

#include <algorithm>
#include <array>
#include <filesystem>
#include <fstream>
#include <set>

#include <sys/stat.h>

#include "host/platform/FileTimes.h"

namespace tessel
{
namespace
{
namespace fs = std::filesystem;

// More is no bundle, but a folder that is called like one.
constexpr std::size_t kMostFiles = 10000;

std::optional<FileFacts> factsOfOne(const fs::path& path)
{
    struct stat status = {};
    if (stat(path.c_str(), &status) != 0)
        return std::nullopt;
    const auto size = S_ISDIR(status.st_mode) ? 0 : static_cast<std::uint64_t>(status.st_size);
    return FileFacts{size, contentTime(status), statusTime(status), status.st_ino};
}

// Everything in the folder, in an order that does not depend on the file system.
std::set<fs::path> filesWithin(const fs::path& folder)
{
    std::set<fs::path> files;
    std::error_code failed;
    for (fs::recursive_directory_iterator entry(folder, failed), end;
         !failed && entry != end && files.size() < kMostFiles; entry.increment(failed))
        files.insert(entry->path());
    return files;
}

constexpr std::uint64_t kFnvStart = 14695981039346656037U;
constexpr std::uint64_t kFnvPrime = 1099511628211U;

void add(std::uint64_t& hash, std::string_view bytes)
{
    for (const char byte : bytes)
        hash = (hash ^ static_cast<unsigned char>(byte)) * kFnvPrime;
}

bool addContent(std::uint64_t& hash, const fs::path& path)
{
    std::ifstream file(path, std::ios::binary);
    std::array<char, 65536> piece;
    while (file.read(piece.data(), piece.size()) || file.gcount() > 0)
        add(hash, {piece.data(), static_cast<std::size_t>(file.gcount())});
    return file.is_open() && !file.bad();
}
} // namespace

std::optional<FileFacts> factsOf(const std::string& path)
{
    auto facts = factsOfOne(path);
    std::error_code failed;
    if (!facts || !fs::is_directory(path, failed))
        return facts;
    for (const auto& file : filesWithin(path))
        if (const auto one = factsOfOne(file))
        {
            facts->size += one->size;
            facts->contentTime = std::max(facts->contentTime, one->contentTime);
            facts->statusTime = std::max(facts->statusTime, one->statusTime);
        }
    return facts;
}

std::optional<std::uint64_t> contentHash(const std::string& path)
{
    std::uint64_t hash = kFnvStart;
    std::error_code failed;
    if (fs::is_regular_file(path, failed))
        return addContent(hash, path) ? std::optional(hash) : std::nullopt;
    if (!fs::is_directory(path, failed))
        return std::nullopt;
    for (const auto& file : filesWithin(path))
    {
        add(hash, file.native());
        if (fs::is_regular_file(file, failed) && !addContent(hash, file))
            return std::nullopt;
    }
    return hash;
}
} // namespace tessel
