#include "host/app/Layout.h"

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

Layout layoutOf(const std::filesystem::path& binaries)
{
    const auto contents = binaries.filename() == kProgramsOfBundle ? binaries.parent_path() : binaries;
    return {binaries, contents / "Resources", contents / "PlugIns"};
}

Layout runningLayout()
{
    Dl_info library{};
    static const char insideOfLibrary = 0;
    std::error_code error;
    std::filesystem::path file;
    if (dladdr(&insideOfLibrary, &library) != 0)
        file = std::filesystem::canonical(library.dli_fname, error);
    return layoutOf(file.parent_path());
}

std::filesystem::path personalFolder()
{
    const auto dataHome = personalDataHome();
    return dataHome.empty() ? dataHome : dataHome / kProductFolder;
}
} // namespace tessel
