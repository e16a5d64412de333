#include "host/console/EndQuestion.h"

#include <cerrno>
#include <string_view>

#include <fcntl.h>
#include <termios.h>
#include <unistd.h>

#include "host/platform/Descriptor.h"

namespace tessel
{
namespace
{
constexpr std::string_view kNo = "Tessel waits on.\n";
constexpr std::string_view kQuestion =
    "\nWhat is running does not come back. End Tessel? What is not stored yet is lost. [y/N] ";

// A terminal that gives whole lines and shows what is typed, for the time of a question.
class LineMode
{
public:
    explicit LineMode(int terminal) : mTerminal(terminal), mKnown(tcgetattr(terminal, &mBefore) == 0)
    {
        termios lines = mBefore;
        lines.c_lflag |= ICANON | ECHO;
        lines.c_iflag |= ICRNL;
        if (mKnown)
            tcsetattr(terminal, TCSAFLUSH, &lines); // what was typed before is no answer
    }
    ~LineMode()
    {
        if (mKnown)
            tcsetattr(mTerminal, TCSANOW, &mBefore);
    }
    LineMode(const LineMode&) = delete;
    LineMode& operator=(const LineMode&) = delete;

private:
    int mTerminal;
    termios mBefore = {};
    bool mKnown;
};

// A terminal that takes no text gives no answer either.
void show(int terminal, std::string_view text)
{
    [[maybe_unused]] const auto written = write(terminal, text.data(), text.size());
}

// The line's first character; 0 when there is none.
char readAnswer(int terminal)
{
    char first = 0;
    char next = 0;
    for (;;)
    {
        const ssize_t count = read(terminal, &next, 1);
        if (count < 0 && errno == EINTR)
            continue;
        if (count != 1 || next == '\n')
            return count == 1 ? first : '\0';
        first = first == 0 ? next : first;
    }
}
} // namespace

EndAnswer askWhetherToEnd() noexcept
{
    const Descriptor terminal(open("/dev/tty", O_RDWR | O_CLOEXEC | O_NOCTTY));
    if (!terminal || tcgetpgrp(terminal.number()) != getpgrp())
        return EndAnswer::kNobodyToAsk;
    const LineMode lines(terminal.number());
    show(terminal.number(), kQuestion);
    const char answer = readAnswer(terminal.number());
    if (answer == 'y' || answer == 'Y')
        return EndAnswer::kEnd;
    show(terminal.number(), kNo);
    return EndAnswer::kWaitOn;
}
} // namespace tessel
