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

// The folders of the running host, as they were when somebody asked first.
const ProductFolders& runningProductFolders();

// From now on what is said is in the person's language (see host/text/Translation.h), where the product has
// it. For the programs, at their beginning: tests speak English.
void usePersonsLanguage();
} // namespace tessel
