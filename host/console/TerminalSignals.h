// What happens to a terminal while a line is being typed: Ctrl-Z, going on after it, another size.
#pragma once

#include <array>
#include <csignal>

#include "host/platform/Pipe.h"

namespace tessel
{
// From its making to its end, these signals are noted instead of obeyed. One at a time; without a pipe left
// in the system they are obeyed as usual.
class TerminalSignals
{
public:
    TerminalSignals();
    ~TerminalSignals();
    TerminalSignals(const TerminalSignals&) = delete;
    TerminalSignals& operator=(const TerminalSignals&) = delete;

    // Can be read from when one has come: whoever waits for input waits for it, too.
    int wakeUp() const { return mPipe.output.number(); }

    struct Came
    {
        bool stop = false;
        bool resume = false;
        bool resize = false;
    };
    // What has come since this was asked last.
    Came take();

    // Stops the process as Ctrl-Z would have; comes back when it goes on, or at once where nobody could make
    // it go on.
    void stop();

private:
    static constexpr std::array kSignals = {SIGTSTP, SIGCONT, SIGWINCH};

    Pipe mPipe;
    std::array<struct sigaction, kSignals.size()> mPrevious = {};
};
} // namespace tessel
