// Where the parts of the product stand: all of them are found from where the host's library stands, so that
// Tessel.app can be moved as a whole and a test program finds them too.
#pragma once

#include <filesystem>
#include <vector>

namespace tessel
{
struct ProductFolders
{
    std::filesystem::path binaries;
    std::filesystem::path resources;
    std::filesystem::path plugIns;
};

// The folders of the app whose programs are in that folder: `Contents/MacOS` or the app's own folder.
ProductFolders productFoldersOf(const std::filesystem::path& binaries);

// The folders of the running host.
ProductFolders runningProductFolders();

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
