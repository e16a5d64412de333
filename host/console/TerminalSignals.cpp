#include "host/console/TerminalSignals.h"

#include <cerrno>
#include <utility>

#include <fcntl.h>
#include <unistd.h>

namespace tessel
{
namespace
{
// A signal handler can be given nothing.
volatile std::sig_atomic_t theNotes = -1;

void note(int signal)
{
    const int before = errno;
    const char name = static_cast<char>(signal);
    // A pipe that is full has notes enough.
    [[maybe_unused]] const auto written = write(theNotes, &name, 1);
    errno = before;
}
} // namespace

TerminalSignals::TerminalSignals()
{
    auto pipe = openPipe();
    if (!pipe)
        return;
    mPipe = *std::move(pipe);
    for (const int end : {mPipe.output.number(), mPipe.input.number()})
        fcntl(end, F_SETFL, O_NONBLOCK);
    theNotes = mPipe.input.number();
    struct sigaction action = {};
    action.sa_handler = note;
    for (std::size_t index = 0; index < kSignals.size(); ++index)
        sigaction(kSignals[index], &action, &mPrevious[index]);
}

TerminalSignals::~TerminalSignals()
{
    for (std::size_t index = 0; mPipe.output && index < kSignals.size(); ++index)
        sigaction(kSignals[index], &mPrevious[index], nullptr);
    theNotes = -1;
}

TerminalSignals::Came TerminalSignals::take()
{
    Came came;
    char signal = 0;
    while (mPipe.output && ::read(mPipe.output.number(), &signal, 1) == 1)
    {
        came.stop = came.stop || signal == SIGTSTP;
        came.resume = came.resume || signal == SIGCONT;
        came.resize = came.resize || signal == SIGWINCH;
    }
    return came;
}

void TerminalSignals::stop()
{
    struct sigaction usual = {};
    usual.sa_handler = SIG_DFL;
    struct sigaction noted = {};
    sigaction(SIGTSTP, &usual, &noted);
    std::raise(SIGTSTP);
    sigaction(SIGTSTP, &noted, nullptr);
}
} // namespace tessel
