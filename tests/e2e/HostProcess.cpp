#include "tests/e2e/HostProcess.h"

#include <algorithm>
#include <csignal>
#include <cstdio>
#include <cstring>
#include <regex>
#include <stdexcept>

#include <fcntl.h>
#include <poll.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include "tests/support/ProgramArguments.h"

extern char** environ;

namespace
{
using Clock = std::chrono::steady_clock;

// Signals that whoever started the tests ignores, by nohup or in the background of a shell: hosts would
// ignore them as well.
struct UsualSignals
{
    UsualSignals()
    {
        for (const int number : {SIGHUP, SIGINT, SIGQUIT, SIGPIPE})
            std::signal(number, SIG_DFL);
    }
} const atTheStart;

class Pipe
{
public:
    Pipe()
    {
        if (pipe2(mEnds, O_CLOEXEC) != 0)
            throw std::runtime_error("no pipe");
    }
    ~Pipe() { close(mEnds[0]); }
    Pipe(const Pipe&) = delete;
    Pipe& operator=(const Pipe&) = delete;

    int readEnd() const { return mEnds[0]; }
    int writeEnd() const { return mEnds[1]; }
    void closeWriteEnd() { close(mEnds[1]); }

private:
    int mEnds[2];
};

pid_t spawn(std::vector<std::string> arguments, std::vector<std::string> environment, int input, int output)
{
    posix_spawn_file_actions_t files;
    posix_spawn_file_actions_init(&files);
    posix_spawn_file_actions_adddup2(&files, input, STDIN_FILENO);
    posix_spawn_file_actions_adddup2(&files, output, STDOUT_FILENO);
    posix_spawn_file_actions_adddup2(&files, output, STDERR_FILENO);
    pid_t process = 0;
    const int error = posix_spawn(&process, arguments.front().c_str(), &files, nullptr,
                                  pointersTo(arguments).data(), pointersTo(environment).data());
    posix_spawn_file_actions_destroy(&files);
    if (error != 0)
        throw std::runtime_error("cannot start " + arguments.front() + ": " + std::strerror(error));
    return process;
}

// Reads to the end of the output; false when the time is over first.
bool collect(int source, std::string& output, Clock::time_point deadline)
{
    for (;;)
    {
        const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(deadline - Clock::now());
        pollfd ready{source, POLLIN, 0};
        if (left.count() <= 0 || poll(&ready, 1, static_cast<int>(left.count())) == 0)
            return false;
        char piece[4096];
        const ssize_t count = read(source, piece, sizeof piece);
        if (count <= 0)
            return true;
        output.append(piece, static_cast<std::size_t>(count));
    }
}

int waitFor(pid_t process)
{
    int status = 0;
    waitpid(process, &status, 0);
    return WIFEXITED(status) ? WEXITSTATUS(status) : -WTERMSIG(status);
}
} // namespace

std::string withoutTimes(const std::string& output)
{
    static const std::regex time(", loaded in [0-9.]+ m?s\n");
    return std::regex_replace(output, time, "\n");
}

HostSession::HostSession()
{
    std::filesystem::create_directories(mFolder / "home");
    set("HOME", (mFolder / "home").string());
    set("TERM", "xterm");
    set("LC_ALL", "C.UTF-8");
    set("LANGUAGE", "");
    set("NO_COLOR", "1");
    set("PAGER", "");
    set("XDG_DATA_HOME", "");
    set("DISPLAY", "");
    set("WAYLAND_DISPLAY", "");
}

void HostSession::startBoundByRights()
{
    if (geteuid() == 0)
        startBy("exec setpriv --bounding-set=-dac_override,-dac_read_search -- \"$0\" \"$@\"");
}

void HostSession::set(const std::string& variable, const std::string& value)
{
    std::erase_if(mEnvironment, [&](const auto& change) { return change.first == variable; });
    mEnvironment.emplace_back(variable, value);
}

std::vector<std::string> HostSession::commandLine(const std::vector<std::string>& arguments) const
{
    std::vector<std::string> all = mLauncher;
    all.insert(all.end(), {TESSEL_PROGRAM, "--profile-dir", profile().string()});
    all.insert(all.end(), mAlways.begin(), mAlways.end());
    all.insert(all.end(), arguments.begin(), arguments.end());
    return all;
}

std::vector<std::string> HostSession::environment() const
{
    std::vector<std::string> result;
    for (char** variable = environ; *variable; ++variable)
    {
        const std::string name(*variable, std::strcspn(*variable, "="));
        const auto changes = [&](const auto& change)
        {
            return change.first == name;
        };
        if (std::ranges::none_of(mEnvironment, changes))
            result.emplace_back(*variable);
    }
    for (const auto& [name, value] : mEnvironment)
        if (!value.empty()) // an empty value takes the variable away
            result.push_back(std::string(name).append("=").append(value));
    return result;
}

HostResult HostSession::start(const std::vector<std::string>& arguments, const std::string& input) const
{
    const auto typed = mFolder.write("input.txt", input);
    const int source = open(typed.c_str(), O_RDONLY | O_CLOEXEC);
    Pipe output;
    const pid_t process = spawn(commandLine(arguments), environment(), source, output.writeEnd());
    close(source);
    output.closeWriteEnd();

    HostResult result;
    result.timedOut = !collect(output.readEnd(), result.output, Clock::now() + kHostTimeLimit);
    if (result.timedOut)
        kill(process, SIGKILL);
    result.exitStatus = waitFor(process);
    if (!mKeepsTimes)
        result.output = withoutTimes(result.output);
    return result;
}

HostResult HostSession::run(const std::vector<std::string>& commands) const
{
    std::vector<std::string> arguments;
    for (const auto& command : commands)
    {
        arguments.emplace_back("-c");
        arguments.push_back(command);
    }
    return start(arguments);
}

HostResult HostSession::runScript(const std::string& lines) const
{
    return start({"--script", mFolder.write("script.txt", lines).string()});
}

HostResult HostSession::runPipe(const std::string& lines) const
{
    return start({}, lines);
}
