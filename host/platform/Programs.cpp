#include "host/platform/Programs.h"

#include <array>
#include <cerrno>
#include <csignal>
#include <initializer_list>
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

class NewProgram
{
public:
    NewProgram()
    {
        posix_spawn_file_actions_init(&mFiles);
        posix_spawnattr_init(&mAttributes);
    }
    ~NewProgram()
    {
        posix_spawnattr_destroy(&mAttributes);
        posix_spawn_file_actions_destroy(&mFiles);
    }
    NewProgram(const NewProgram&) = delete;
    NewProgram& operator=(const NewProgram&) = delete;

    void readFrom(int descriptor) { posix_spawn_file_actions_adddup2(&mFiles, descriptor, STDIN_FILENO); }
    void writeTo(int descriptor) { posix_spawn_file_actions_adddup2(&mFiles, descriptor, STDOUT_FILENO); }
    void writeNowhere() { posix_spawn_file_actions_addopen(&mFiles, STDOUT_FILENO, kNowhere, O_WRONLY, 0); }

    void leaveTheTerminal()
    {
        leaveAsUsual({}, POSIX_SPAWN_SETSID);
        posix_spawn_file_actions_addopen(&mFiles, STDIN_FILENO, kNowhere, O_RDONLY, 0);
        posix_spawn_file_actions_addopen(&mFiles, STDERR_FILENO, kNowhere, O_WRONLY, 0);
    }

    void shareTheTerminal() { leaveAsUsual({SIGINT, SIGQUIT}, 0); }

    // Nothing when there is no such program. To be called once, with all of the above settled.
    std::optional<pid_t> start(ProgramWords words)
    {
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
    // These signals, and those that the host does without, do to the program what they usually do.
    void leaveAsUsual(std::initializer_list<int> signals, int otherFlags)
    {
        sigset_t usual;
        sigemptyset(&usual);
        for (const int signal : {SIGPIPE, SIGXFSZ})
            sigaddset(&usual, signal);
        for (const int signal : signals)
            sigaddset(&usual, signal);
        posix_spawnattr_setsigdefault(&mAttributes, &usual);
        posix_spawnattr_setflags(&mAttributes, static_cast<short>(POSIX_SPAWN_SETSIGDEF | otherFlags));
    }

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

// As `waitpid` has it.
int statusAtEndOf(pid_t process)
{
    int status = 0;
    while (waitpid(process, &status, 0) < 0 && errno == EINTR)
        continue;
    return status;
}
} // namespace

bool startProgram(ProgramWords words)
{
    std::erase_if(startedPrograms(), [](pid_t process) { return waitpid(process, nullptr, WNOHANG) != 0; });
    NewProgram program;
    program.writeNowhere();
    program.leaveTheTerminal();
    const auto process = program.start(std::move(words));
    if (process)
        startedPrograms().push_back(*process);
    return process.has_value();
}

std::string outputOfProgram(ProgramWords words)
{
    auto pipe = openPipe();
    if (!pipe)
        return "";
    NewProgram program;
    program.writeTo(pipe->input.number());
    program.leaveTheTerminal();
    const auto process = program.start(std::move(words));
    if (!process)
        return "";
    pipe->input = Descriptor(-1); // otherwise the output would not end
    const std::string text = readToEnd(pipe->output);
    statusAtEndOf(*process);
    return text;
}

std::optional<int> showByProgram(ProgramWords words, std::string_view text)
{
    auto pipe = openPipe();
    if (!pipe)
        return std::nullopt;
    NewProgram program;
    program.shareTheTerminal();
    program.readFrom(pipe->output.number());
    const auto process = program.start(std::move(words));
    pipe->output = Descriptor(-1); // otherwise nobody would learn that the program reads no more
    if (!process)
        return std::nullopt;
    static_cast<void>(pipe->input.write(text)); // who leaves early has read enough
    pipe->input = Descriptor(-1);
    return statusAtEndOf(*process);
}
} // namespace tessel
