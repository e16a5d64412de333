#include "host/console/Pager.h"

#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <optional>
#include <string_view>
#include <utility>
#include <vector>

#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include "host/platform/Pipe.h"

extern char** environ;

namespace tessel
{
namespace
{
using PagerArguments = std::vector<std::string>;

constexpr int kStatusOfInterrupt = 128 + SIGINT; // as shells have it

std::optional<PagerArguments> pagerWords()
{
    const char* pager = std::getenv("PAGER");
    const char* terminal = std::getenv("TERM");
    const std::string_view kind = terminal ? terminal : "";
    if (pager)
        return *pager ? std::optional(PagerArguments{"/bin/sh", "-c", pager}) : std::nullopt;
    if (kind.empty() || kind == "dumb")
        return std::nullopt;
    return PagerArguments{"less", "-FRX"};
}

// What is pressed is for the pager, which is told by the terminal itself.
class KeysForThePager
{
public:
    KeysForThePager()
    {
        struct sigaction ignored = {};
        ignored.sa_handler = SIG_IGN;
        sigaction(SIGINT, &ignored, &mInterrupt);
        sigaction(SIGQUIT, &ignored, &mQuit);
    }
    ~KeysForThePager()
    {
        sigaction(SIGINT, &mInterrupt, nullptr);
        sigaction(SIGQUIT, &mQuit, nullptr);
    }
    KeysForThePager(const KeysForThePager&) = delete;
    KeysForThePager& operator=(const KeysForThePager&) = delete;

private:
    struct sigaction mInterrupt = {};
    struct sigaction mQuit = {};
};

sigset_t signalsOfAUsualProgram()
{
    sigset_t signals;
    sigemptyset(&signals);
    for (const int signal : {SIGINT, SIGQUIT, SIGPIPE, SIGXFSZ})
        sigaddset(&signals, signal);
    return signals;
}

// With the signals that the host does without as they usually are. Nothing when there is no such program.
std::optional<pid_t> start(PagerArguments words, int input)
{
    posix_spawn_file_actions_t files;
    posix_spawn_file_actions_init(&files);
    posix_spawn_file_actions_adddup2(&files, input, STDIN_FILENO);
    posix_spawnattr_t attributes;
    posix_spawnattr_init(&attributes);
    const sigset_t usual = signalsOfAUsualProgram();
    posix_spawnattr_setsigdefault(&attributes, &usual);
    posix_spawnattr_setflags(&attributes, POSIX_SPAWN_SETSIGDEF);
    std::vector<char*> pointers;
    for (std::string& word : words)
        pointers.push_back(word.data());
    pointers.push_back(nullptr);
    pid_t process = 0;
    const int error = posix_spawnp(&process, pointers.front(), &files, &attributes, pointers.data(), environ);
    posix_spawnattr_destroy(&attributes);
    posix_spawn_file_actions_destroy(&files);
    return error == 0 ? std::optional(process) : std::nullopt;
}

int statusOf(pid_t process)
{
    int status = 0;
    while (waitpid(process, &status, 0) < 0 && errno == EINTR)
        continue;
    return status;
}

// Leaving it with Ctrl-C is a way of having read enough.
bool hasShown(int status)
{
    if (WIFSIGNALED(status))
        return WTERMSIG(status) == SIGINT;
    return WEXITSTATUS(status) == 0 || WEXITSTATUS(status) == kStatusOfInterrupt;
}
} // namespace

bool showInPager(const std::string& text)
{
    auto words = pagerWords();
    auto pipe = openPipe();
    if (!words || !pipe)
        return false;
    const KeysForThePager keys;
    const auto process = start(*std::move(words), pipe->output.number());
    pipe->output = Descriptor(-1);
    if (!process)
        return false;
    static_cast<void>(pipe->input.write(text)); // who leaves early has read enough
    pipe->input = Descriptor(-1);
    return hasShown(statusOf(*process));
}
} // namespace tessel
