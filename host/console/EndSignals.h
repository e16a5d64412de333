// The signals by which the system asks a program to end: SIGTERM, and SIGHUP when the terminal is gone.
#pragma once

#include <array>
#include <csignal>

#include "host/console/LineRunner.h"

namespace tessel
{
// From its making to its end these signals end the runner's session in good order; after one has, they are
// ignored for the rest of the process. One that comes some seconds after the first ends the process at once
// if an application is at work, which is then named, or Lisp that does not come back. One object at a time.
class EndSignals
{
public:
    explicit EndSignals(LineRunner& runner);
    ~EndSignals();
    EndSignals(const EndSignals&) = delete;
    EndSignals& operator=(const EndSignals&) = delete;

    // The first signal that came, or 0.
    static int received();

private:
    static constexpr std::array kSignals = {SIGTERM, SIGHUP};

    std::array<struct sigaction, kSignals.size()> mPrevious = {};
};
} // namespace tessel
