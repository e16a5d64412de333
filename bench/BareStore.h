// The rows of a registry by the store's own calls alone: one prepared statement, one transaction. What the
// registry adds to that is the registry's to answer for.
#pragma once

#include <cstddef>
#include <filesystem>
#include <string>

namespace bench
{
// Reads so many entries of the History in the registry's file, each by its name. False when one is not there.
bool readBare(const std::filesystem::path& registry, std::size_t count);

// Makes an empty file with the same tables and indexes as the registry's.
bool makeBare(const std::filesystem::path& registry, const std::filesystem::path& file);

// Removes the rows that an earlier run has stored in a file of `makeBare`, one by one, if it is told so, and
// stores so many. `pathOf` answers the text of each, in UTF-8.
bool writeBare(const std::filesystem::path& file, std::size_t count, bool removeFirst,
               std::string (*pathOf)(std::size_t));
} // namespace bench
