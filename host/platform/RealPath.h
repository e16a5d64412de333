// One name for a file, whatever links and detours its path takes.
#pragma once

#include <filesystem>
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
} // namespace tessel
