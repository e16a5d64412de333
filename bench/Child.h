// Measuring in a child process: what can be done only once in a process, such as mapping a library for the
// first time.
#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace bench
{
// Runs the work in a fork of this process and answers the seconds that it answered; negative when the child
// did not come to its end.
double inChild(const std::function<double()>& work);

// Runs this program again with the arguments and answers the seconds that it told; negative when it did
// not end well.
double inNewProcess(const std::vector<std::string>& arguments);

// What a program that inNewProcess() has started prints, and nothing else: the seconds, and the instructions
// where they were counted.
void tellSeconds(double seconds);

// Seconds of processor time, the system's included, that the work takes of this process. Machines are shared:
// what others do meanwhile lengthens the time on the clock, of long runs more often than of short ones.
double secondsOf(const std::function<void()>& work);

// The instructions of the work that took these seconds, just as one of the functions above has answered them:
// nobody has to carry both around. Nothing where they were not counted.
std::optional<double> instructionsOf(double seconds);
} // namespace bench
