// Measuring in a child process: what can be done only once in a process, such as mapping a library for the
// first time.
#pragma once

#include <functional>

namespace bench
{
// Runs the work in a fork of this process and answers the seconds that it answered; negative when the child
// did not come to its end.
double inChild(const std::function<double()>& work);

// Seconds that the work takes.
double secondsOf(const std::function<void()>& work);
} // namespace bench
