#include "host/app/ProductFolders.h"

#include <cstdlib>

#include <dlfcn.h>

#include "host/app/platform/DataHome.h"

namespace tessel
{
namespace
{
constexpr char kProductFolder[] = "Tessel";
constexpr char kProgramsOfBundle[] = "MacOS"; // Tessel.app/Contents/MacOS
} // namespace

ProductFolders productFoldersOf(const std::filesystem::path& binaries)
{
    const auto contents = binaries.filename() == kProgramsOfBundle ? binaries.parent_path() : binaries;
    return {binaries, contents / "Resources", contents / "PlugIns"};
}

ProductFolders runningProductFolders()
{
    Dl_info library{};
    static const char insideOfLibrary = 0;
    std::error_code error;
    std::filesystem::path file;
    if (dladdr(&insideOfLibrary, &library) != 0)
        file = std::filesystem::canonical(library.dli_fname, error);
    return productFoldersOf(file.parent_path());
}

std::filesystem::path personalFolder()
{
    const auto dataHome = personalDataHome();
    return dataHome.empty() ? dataHome : dataHome / kProductFolder;
}
} // namespace tessel
