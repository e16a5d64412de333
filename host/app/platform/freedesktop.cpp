#include "host/app/platform/DataHome.h"
#include "host/app/platform/Terminal.h"

#include <algorithm>
#include <cstdlib>
#include <sstream>
#include <string>

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

// The first of the variable is the most important one. Relative paths count for nothing here, too.
std::vector<std::filesystem::path> machineFolders()
{
    const char* named = std::getenv("XDG_CONFIG_DIRS");
    std::istringstream all(named && *named ? named : "/etc/xdg");
    std::vector<std::filesystem::path> folders;
    for (std::string folder; std::getline(all, folder, ':');)
        if (std::filesystem::path(folder).is_absolute())
            folders.push_back(std::filesystem::path(folder) / "tessel");
    std::ranges::reverse(folders);
    folders.emplace_back("/etc/tessel");
    return folders;
}

ProgramWords programInTerminal(const std::filesystem::path&)
{
    return {};
}
} // namespace tessel
