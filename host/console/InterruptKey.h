// Ctrl-C: it stops what is running in the host, not the host.
#pragma once

#include <csignal>

#include "host/console/LineRunner.h"

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

private:
    struct sigaction mPrevious
    {
    };
};
} // namespace tessel
