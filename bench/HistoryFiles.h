// Files for a History: so many Lisp files, a hundred in each folder, as on a disk that has been used for long.
#pragma once

#include <cstddef>
#include <string>
#include <vector>

namespace bench
{
enum class Files
{
    kThere,
    kGone // of which not even the folders are left
};

// The paths of so many; those that are to be there are made, once in a run.
std::vector<std::string> historyFiles(std::size_t count, Files files);

// Replaces the module's History with the paths.
void setHistory(const std::vector<std::string>& paths);
} // namespace bench
