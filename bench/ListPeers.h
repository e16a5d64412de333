// Others that store and read a list: QSettings (INI) and GKeyFile, all or nothing.
#pragma once

#include <cstddef>
#include <filesystem>

#include "bench/Entries.h"

namespace bench
{
// Each stores a list of so many numbered paths, or reads one that it has stored, in a file that it has not
// seen before in this process. False when not all of it is stored, or there.
//
// All of them write a new file, have the system bring it to the disk, and give it the old one's name.
bool storeByQSettings(const std::filesystem::path& file, std::size_t count, PathOf pathOf);
bool readByQSettings(const std::filesystem::path& file, std::size_t count);
bool storeByGKeyFile(const std::filesystem::path& file, std::size_t count, PathOf pathOf);
bool readByGKeyFile(const std::filesystem::path& file, std::size_t count);
} // namespace bench
