// Files for a History: so many Lisp files, a hundred in each folder, as on a disk that has been used for
// long.
#pragma once

#include <cstddef>
#include <string>

namespace bench
{
enum class Files
{
    kThere,
    kGone // of which not even the folders are left
};

// Makes so many, once in a run, unless they are to be gone. Programs that this one starts find them too.
void makeHistoryFiles(std::size_t count, Files files);

// The path of one of them.
std::string historyFile(std::size_t number, Files files);

// Replaces the module's History with so many.
void setHistory(std::size_t count, Files files);
} // namespace bench
