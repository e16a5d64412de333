#include "host/messages/Help.h"

#include <algorithm>
#include <array>
#include <string>

#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include "host/messages/platform/Desktop.h"

extern char** environ;

namespace tessel
{
namespace
{
// Through a shell that leaves the browser behind: nobody waits for it, and it is nobody's child. False when
// there is no such program.
bool startAndForget(std::string program, std::string argument)
{
    std::string shell = "sh", option = "-c";
    std::string script = R"(command -v "$0" >/dev/null || exit; "$0" "$1" </dev/null >/dev/null 2>&1 &)";
    std::array arguments = {shell.data(),   option.data(),   script.data(),
                            program.data(), argument.data(), static_cast<char*>(nullptr)};
    pid_t process = 0;
    if (posix_spawn(&process, "/bin/sh", nullptr, nullptr, arguments.data(), environ) != 0)
        return false;
    int status = 0;
    return waitpid(process, &status, 0) == process && status == 0;
}
} // namespace

bool openInBrowser(const std::filesystem::path& page)
{
    return hasDisplay() && std::ranges::any_of(pageOpeners(), [&page](const std::string& opener)
                                               { return startAndForget(opener, page.string()); });
}
} // namespace tessel
