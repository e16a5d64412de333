#include "host/app/platform/DataHome.h"

#include <cstdlib>

namespace tessel
{
// A relative path in the variable counts as none, as it does for every program that keeps to these folders.
std::filesystem::path personalDataHome()
{
    const char* dataHome = std::getenv("XDG_DATA_HOME");
    if (dataHome && std::filesystem::path(dataHome).is_absolute())
        return dataHome;
    const char* home = std::getenv("HOME");
    return home && *home ? std::filesystem::path(home) / ".local/share" : std::filesystem::path();
}
} // namespace tessel
