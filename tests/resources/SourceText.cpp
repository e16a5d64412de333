#include "tests/resources/SourceText.h"

#include <fstream>
#include <iterator>
#include <set>

std::filesystem::path sourceRoot()
{
    return MODRIG_SOURCE_ROOT;
}

std::string readFile(const std::filesystem::path& file)
{
    std::ifstream stream(file, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), {}};
}

std::string moduleSources()
{
    const std::set<std::filesystem::path> kCode = {".h", ".cpp", ".mm"};
    std::string sources;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(sourceRoot() / "modrig"))
        if (kCode.contains(entry.path().extension()))
            sources += readFile(entry.path());
    return sources;
}
