#include "host/app/platform/DataHome.h"

#include <cstdlib>

namespace tessel
{
std::filesystem::path personalDataHome()
{
    const char* home = std::getenv("HOME");
    return home && *home ? std::filesystem::path(home) / "Library/Application Support"
                         : std::filesystem::path();
}

std::vector<std::filesystem::path> machineFolders()
{
    return {"/Library/Application Support/Tessel"};
}
} // namespace tessel
