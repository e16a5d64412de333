// Where a person's own profile is kept, and what is laid out for everybody.
#pragma once

#include <filesystem>
#include <vector>

namespace tessel
{
// Where a person's own profile is kept: $XDG_DATA_HOME/Tessel or ~/.local/share/Tessel, or in
// Application Support. Empty when the environment names no home.
std::filesystem::path personalFolder();

// Where values for everybody are laid out, later ones before earlier: the folders that the machine's own
// names (on a network, say), those that this platform has for such things, one to try, and the machine's own.
std::vector<std::filesystem::path> layoutFolders(const std::filesystem::path& toTry);

// The further folders that are named in what is laid out there, separated by colons; relative ones are passed
// over.
std::vector<std::filesystem::path> furtherLayoutFolders(const std::filesystem::path& folder);
} // namespace tessel
