// What the measured work is charged with.
#pragma once

#include <ctime>

#include <sys/types.h>

namespace bench
{
inline double secondsOn(clockid_t clock)
{
    timespec spent = {};
    if (clock_gettime(clock, &spent) != 0)
        return 0;
    return static_cast<double>(spent.tv_sec) + static_cast<double>(spent.tv_nsec) * 1e-9;
}

// Processor time of this process so far.
inline double processorSeconds()
{
    return secondsOn(CLOCK_PROCESS_CPUTIME_ID);
}

// The same with that of the display, where its process is known; 0 is not.
inline double processorSeconds(pid_t display)
{
    clockid_t clock = 0;
    const bool isKnown = display > 0 && clock_getcpuclockid(display, &clock) == 0;
    return processorSeconds() + (isKnown ? secondsOn(clock) : 0);
}
} // namespace bench
