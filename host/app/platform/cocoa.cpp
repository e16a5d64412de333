#include "host/app/platform/DataHome.h"
#include "host/app/platform/Terminal.h"

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

// The Finder gives no program a terminal.
ProgramWords programInTerminal(const std::filesystem::path& program)
{
    return {"open", "-b", "com.apple.Terminal", program.string()};
}
} // namespace tessel
