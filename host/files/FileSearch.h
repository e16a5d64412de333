// Finding a file by name along an ordered search path.
#pragma once

#include <filesystem>
#include <optional>
#include <vector>

namespace tessel
{
class SystemVariables;

class FileSearch
{
public:
    // `hostFolder` is searched after the current folder and before those of the variable SEARCHPATH.
    FileSearch(std::filesystem::path hostFolder, const SystemVariables& variables);

    // The full path of the first match. A full path is only checked for existence.
    std::optional<std::filesystem::path> find(const std::filesystem::path& name) const;

private:
    std::vector<std::filesystem::path> folders() const;

    std::filesystem::path mHostFolder;
    const SystemVariables& mVariables;
};
} // namespace tessel
