#include "host/console/Pager.h"

#include <csignal>
#include <cstdlib>
#include <optional>
#include <string_view>
#include <utility>

#include <sys/wait.h>

#include "host/platform/Programs.h"

namespace tessel
{
namespace
{
constexpr int kStatusOfInterrupt = 128 + SIGINT; // as shells have it

std::optional<ProgramWords> pagerWords()
{
    const char* pager = std::getenv("PAGER");
    const char* terminal = std::getenv("TERM");
    const std::string_view kind = terminal ? terminal : "";
    if (pager)
        return *pager ? std::optional(ProgramWords{"/bin/sh", "-c", pager}) : std::nullopt;
    if (kind.empty() || kind == "dumb")
        return std::nullopt;
    return ProgramWords{"less", "-FRX"};
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
    if (!words)
        return false;
    const KeysForThePager keys;
    const auto status = showByProgram(*std::move(words), text);
    return status && hasShown(*status);
}
} // namespace tessel
