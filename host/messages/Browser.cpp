#include "host/messages/Help.h"

#include <array>
#include <cstdlib>
#include <sstream>
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
std::string findProgram(const std::string& name)
{
    const char* searchPath = std::getenv("PATH");
    std::istringstream folders(searchPath ? searchPath : "");
    for (std::string folder; std::getline(folders, folder, ':');)
        if (auto program = std::filesystem::path(folder) / name; access(program.c_str(), X_OK) == 0)
            return program.string();
    return {};
}

std::string findOpener()
{
    for (const auto& name : pageOpeners())
        if (auto program = findProgram(name); !program.empty())
            return program;
    return {};
}

// Through a shell that leaves the browser behind: nobody waits for it, and it is nobody's child.
bool startAndForget(std::string program, std::string argument)
{
    std::string shell = "sh", option = "-c";
    std::string script = R"("$0" "$1" </dev/null >/dev/null 2>&1 &)";
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
    const std::string opener = hasDisplay() ? findOpener() : std::string();
    return !opener.empty() && startAndForget(opener, page.string());
}
} // namespace tessel
