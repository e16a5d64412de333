// Where the parts of the product stand: all of them are found from where the host's library stands, so that
// Tessel.app can be moved as a whole and a test program finds them too.
#pragma once

#include <filesystem>

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
} // namespace tessel
