#include "host/platform/ProductFolders.h"

#include <system_error>

#include <dlfcn.h>

#include "host/text/Languages.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
constexpr char kProgramsOfBundle[] = "MacOS"; // Tessel.app/Contents/MacOS
constexpr char kTranslations[] = "locale";    // among the resources

ProductFolders foldersOfThisLibrary()
{
    Dl_info library{};
    static const char insideOfLibrary = 0;
    std::error_code error;
    std::filesystem::path file;
    if (dladdr(&insideOfLibrary, &library) != 0)
        file = std::filesystem::canonical(library.dli_fname, error);
    return productFoldersOf(file.parent_path());
}
} // namespace

ProductFolders productFoldersOf(const std::filesystem::path& binaries)
{
    const auto contents = binaries.filename() == kProgramsOfBundle ? binaries.parent_path() : binaries;
    return {binaries, contents / "Resources", contents / "PlugIns"};
}

const ProductFolders& runningProductFolders()
{
    static const ProductFolders folders = foldersOfThisLibrary();
    return folders;
}

void usePersonsLanguage()
{
    useTranslations(runningProductFolders().resources / kTranslations, personsLanguages());
}
} // namespace tessel
