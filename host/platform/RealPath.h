// One name for a file, whatever links and detours its path takes.
#pragma once

#include <filesystem>
#include <string_view>
#include <system_error>

namespace tessel
{
// The path without links and detours, as far as it is there; as it stands when it cannot be followed.
inline std::filesystem::path realPath(const std::filesystem::path& path)
{
    std::error_code failed;
    auto real = std::filesystem::weakly_canonical(path, failed);
    return failed ? path : real;
}

// Whether the path is the folder or leads into it, both without links and detours.
inline bool isWithin(std::string_view path, std::string_view folder)
{
    return !folder.empty() &&
           (path == folder || (path.starts_with(folder) && path.substr(folder.size()).starts_with('/')));
}
} // namespace tessel
