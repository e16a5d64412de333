#include "host/messages/Help.h"

#include <algorithm>
#include <array>
#include <string>
#include <vector>

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include "host/messages/platform/Desktop.h"

extern char** environ;

namespace tessel
{
namespace
{
// How a program starts that has nothing to do with the terminal: it reads and writes nothing there, and
// Ctrl-C at the prompt is not for it.
class AwayFromTheTerminal
{
public:
    AwayFromTheTerminal()
    {
        posix_spawn_file_actions_init(&mFiles);
        posix_spawn_file_actions_addopen(&mFiles, STDIN_FILENO, "/dev/null", O_RDWR, 0);
        for (const int output : {STDOUT_FILENO, STDERR_FILENO})
            posix_spawn_file_actions_adddup2(&mFiles, STDIN_FILENO, output);
        posix_spawnattr_init(&mAttributes);
        posix_spawnattr_setflags(&mAttributes, POSIX_SPAWN_SETSID);
    }
    ~AwayFromTheTerminal()
    {
        posix_spawnattr_destroy(&mAttributes);
        posix_spawn_file_actions_destroy(&mFiles);
    }
    AwayFromTheTerminal(const AwayFromTheTerminal&) = delete;
    AwayFromTheTerminal& operator=(const AwayFromTheTerminal&) = delete;

    const posix_spawn_file_actions_t* files() const { return &mFiles; }
    const posix_spawnattr_t* attributes() const { return &mAttributes; }

private:
    posix_spawn_file_actions_t mFiles{};
    posix_spawnattr_t mAttributes{};
};

// Nobody waits for a browser: those that have ended are put away when the next one starts.
std::vector<pid_t>& startedBrowsers()
{
    static std::vector<pid_t> browsers;
    return browsers;
}

// False when there is no such program.
bool startAndForget(std::string program, std::string argument)
{
    std::erase_if(startedBrowsers(), [](pid_t process) { return waitpid(process, nullptr, WNOHANG) != 0; });
    const AwayFromTheTerminal start;
    std::array arguments = {program.data(), argument.data(), static_cast<char*>(nullptr)};
    pid_t process = 0;
    if (posix_spawnp(&process, program.c_str(), start.files(), start.attributes(), arguments.data(),
                     environ) != 0)
        return false;
    startedBrowsers().push_back(process);
    return true;
}
} // namespace

bool openInBrowser(const std::filesystem::path& page)
{
    return hasDisplay() && std::ranges::any_of(pageOpeners(), [&page](const std::string& opener)
                                               { return startAndForget(opener, page.string()); });
}
} // namespace tessel
