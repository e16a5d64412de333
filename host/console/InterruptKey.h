// Ctrl-C: it stops what is running in the host, not the host. Where it is pressed in vain, the person at the
// terminal is asked whether the program is to end all the same; where nobody can be asked, it ends. Its
// status is 130 then.
#pragma once

#include <csignal>

#include "host/console/LineRunner.h"
#include "host/platform/Pipe.h"

namespace tessel
{
// From its making to its end, Ctrl-C goes to the runner. One at a time.
class InterruptKey
{
public:
    explicit InterruptKey(LineRunner& runner);
    ~InterruptKey();
    InterruptKey(const InterruptKey&) = delete;
    InterruptKey& operator=(const InterruptKey&) = delete;

    // A descriptor that can be read from when the key was pressed: whoever waits for input waits for it, too.
    // A signal alone can arrive just before the waiting begins, and be lost.
    int wakeUp() const { return mPipe.output.number(); }

private:
    struct sigaction mPrevious
    {
    };
    Pipe mPipe;
};
} // namespace tessel
