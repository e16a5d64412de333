#include "host/platform/Programs.h"

#include <array>
#include <cerrno>
#include <optional>
#include <utility>

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include "host/platform/Descriptor.h"
#include "host/platform/Pipe.h"

extern char** environ;

namespace tessel
{
namespace
{
constexpr char kNowhere[] = "/dev/null";

class ProgramStart
{
public:
    ProgramStart()
    {
        posix_spawn_file_actions_init(&mFiles);
        posix_spawnattr_init(&mAttributes);
        posix_spawnattr_setflags(&mAttributes, POSIX_SPAWN_SETSID);
    }
    ~ProgramStart()
    {
        posix_spawnattr_destroy(&mAttributes);
        posix_spawn_file_actions_destroy(&mFiles);
    }
    ProgramStart(const ProgramStart&) = delete;
    ProgramStart& operator=(const ProgramStart&) = delete;

    void writeTo(int descriptor) { posix_spawn_file_actions_adddup2(&mFiles, descriptor, STDOUT_FILENO); }
    void writeNowhere() { posix_spawn_file_actions_addopen(&mFiles, STDOUT_FILENO, kNowhere, O_WRONLY, 0); }

    // Nothing when there is no such program. To be called once, with the output settled.
    std::optional<pid_t> start(ProgramWords words)
    {
        posix_spawn_file_actions_addopen(&mFiles, STDIN_FILENO, kNowhere, O_RDONLY, 0);
        posix_spawn_file_actions_addopen(&mFiles, STDERR_FILENO, kNowhere, O_WRONLY, 0);
        std::vector<char*> pointers;
        for (std::string& word : words)
            pointers.push_back(word.data());
        pointers.push_back(nullptr);
        pid_t process = 0;
        if (posix_spawnp(&process, pointers.front(), &mFiles, &mAttributes, pointers.data(), environ) != 0)
            return std::nullopt;
        return process;
    }

private:
    posix_spawn_file_actions_t mFiles{};
    posix_spawnattr_t mAttributes{};
};

// Nobody waits for these: those that have ended are put away when the next one starts.
std::vector<pid_t>& startedPrograms()
{
    static std::vector<pid_t> programs;
    return programs;
}

std::string readToEnd(const Descriptor& output)
{
    std::string text;
    std::array<char, 1024> piece{};
    ssize_t count = 0;
    while ((count = read(output.number(), piece.data(), piece.size())) > 0 || (count < 0 && errno == EINTR))
        text.append(piece.data(), count > 0 ? static_cast<std::size_t>(count) : 0);
    return text;
}

void waitForEnd(pid_t process)
{
    while (waitpid(process, nullptr, 0) < 0 && errno == EINTR)
        continue;
}
} // namespace

bool startProgram(ProgramWords words)
{
    std::erase_if(startedPrograms(), [](pid_t process) { return waitpid(process, nullptr, WNOHANG) != 0; });
    ProgramStart start;
    start.writeNowhere();
    const auto process = start.start(std::move(words));
    if (process)
        startedPrograms().push_back(*process);
    return process.has_value();
}

std::string outputOfProgram(ProgramWords words)
{
    auto pipe = openPipe();
    if (!pipe)
        return "";
    ProgramStart start;
    start.writeTo(pipe->input.number());
    const auto process = start.start(std::move(words));
    if (!process)
        return "";
    pipe->input = Descriptor(-1); // otherwise the output would not end
    const std::string text = readToEnd(pipe->output);
    waitForEnd(*process);
    return text;
}
} // namespace tessel
