#include "host/app/platform/DataHome.h"

#include <cstdlib>

#include "host/app/platform/ToolkitPlaces.h"

namespace tessel
{
std::filesystem::path personalDataHome()
{
    const char* home = std::getenv("HOME");
    return home && *home ? std::filesystem::path(home) / "Library/Application Support"
                         : std::filesystem::path();
}

// The system keeps what belongs to the program under the program's name.
std::string keepToolkitFilesIn(const std::string&)
{
    return {};
}
} // namespace tessel
