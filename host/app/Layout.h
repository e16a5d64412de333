// Where the parts of the product stand: all of them are found from where the host's library stands, so that
// Tessel.app can be moved as a whole and a test program finds them too.
#pragma once

#include <filesystem>

namespace tessel
{
struct Layout
{
    std::filesystem::path binaries;
    std::filesystem::path resources;
    std::filesystem::path plugIns;
};

// The layout of the app whose programs are in that folder: `Contents/MacOS` or the app's own folder.
Layout layoutOf(const std::filesystem::path& binaries);

// The layout of the running host.
Layout runningLayout();

// Where a person's own profile is kept: $XDG_DATA_HOME/Tessel or ~/.local/share/Tessel, or in
// Application Support. Empty when the environment names no home.
std::filesystem::path personalFolder();
} // namespace tessel
